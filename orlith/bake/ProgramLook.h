#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "lut/LUT3D.h"
#include "lut/evaluation/Look.h"

namespace orlith {

/// A program that makes an image of an image, and by which images.
struct ProgramLook {
    std::vector<std::string> words;  ///< the program and its arguments; {in} and {out} among them
    std::string imageType;           ///< exr, tif, dpx or png
    bool isForced = false;           ///< takes an image that does not look like a pattern

    /// Whether numbers below 0 and above 1 do not get through: 16-bit integers, not floats.
    bool clips() const { return imageType != "exr"; }
};

/// Sends the test pattern through a look and then through a program, by images in a folder that is
/// removed. Meanwhile whatever wants to end this program ends that one first.
///
/// @param before  empty: none
/// @param size    points a side, as of the CMSTestPattern operator
/// @return        the look of both from 0 to 1
/// @throws Failure    the program fails, leaves no image, or one that is refused as a pattern
/// @throws Cancelled
boost::shared_ptr<Orlith::LUT::LUT3D> bakeProgram(const ProgramLook& program,
                                                  const Orlith::LUT::ColourWay& before, int size);

}  // namespace orlith
