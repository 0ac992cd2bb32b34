#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "lut/LUT.h"

namespace Orlith::LUT {

/// Why the files of a format cannot hold a table with its look as it is, such as "a shaper"; empty
/// if they can.
/// @throws std::invalid_argument  nothing is written as that
std::string whyNotHeld(const LUT& lut, const std::string& extension);

/// Whether the files of a format have a place for a pre-LUT that is the operator's: a ramp in front
/// of the lattice.
bool takesRamp(const std::string& extension);

/// A table as a format holds it.
struct Fitted {
    boost::shared_ptr<LUT> lut;
    std::string whyResampled;  ///< empty: the table as it is
    bool losesInputs;          ///< its domain is smaller than the table's
};

/// Makes a table that a format's writer, as other programs mean the format, holds with its look:
/// the table itself where it can be, otherwise one whose points are the table's own look there.
///
/// @param size       points a side wanted; 0: the table's own, or 33 where a curve becomes a
///                   lattice
/// @throws std::invalid_argument  the format has no tables of that size, or with samples that are
///                                not finite; the text says so
Fitted fit(const boost::shared_ptr<LUT>& lut, const std::string& extension, int size);

}  // namespace Orlith::LUT
