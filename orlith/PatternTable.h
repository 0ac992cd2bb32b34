#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "lut/LUT3D.h"
#include "zefra/Iop.h"

namespace orlith {

/// Refuses an image that cannot hold a test pattern of two points, and warns where it holds fewer
/// patches than the pattern that its width stands for.
/// @param image  validated
/// @throws Failure
void checkPattern(const std::string& path, const zefra::Iop& image);

/// The table that a processed pattern stands for, read without the operator: what a file that the
/// operator wrote is compared with.
/// @param image  validated, and checked
boost::shared_ptr<Orlith::LUT::LUT3D> tableOfPattern(zefra::Iop& image);

}  // namespace orlith
