#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "lut/LUT3D.h"
#include "zefra/Iop.h"

namespace orlith {

/// A processed test pattern, read without the operator.
struct PatternReading {
    /// What the pattern stands for: the centres of its patches.
    boost::shared_ptr<Orlith::LUT::LUT3D> table;
    /// What a table cannot hold, and what speaks against the image: a sentence each, with its name.
    std::vector<std::string> warnings;
};

/// Reads a pattern and looks at whole patches while it does. Each row is fetched once, in order;
/// only the table and one row of patches are kept.
///
/// Refused     a size that no pattern has, pixels that do not begin at column 0 and row 0, a
///             pattern that is turned or mirrored
/// Warned of   patches that are not flat, padding of another colour, samples that are not finite
///
/// @param name      of the image, for the messages
/// @param image     validated
/// @param isForced  turns refusals into warnings; too few pixels for two points are refused always
/// @throws Failure    the image is refused
/// @throws Cancelled
PatternReading readPattern(const std::string& name, zefra::Iop& image, bool isForced);

}  // namespace orlith
