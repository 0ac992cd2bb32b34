#pragma once

#include <string>

#include "lut/LUT.h"
#include "lut/io/table/Proof.h"
#include "orlith/table/TableFile.h"
#include "orlith/table/WriteOptions.h"

namespace orlith {

using Orlith::LUT::readingOf;

/// Why a file of a table, which the format's writer takes, could not be read again; empty if it
/// can.
std::string whyUnreadable(const std::string& extension, const Orlith::LUT::LUT& table);

/// What the codes of a .3dl file do not reach: "clipped: 12 numbers, the farthest 1.5"; empty where
/// all samples fit, and for other formats.
std::string clippingText(const Orlith::LUT::LUT& lut, const std::string& extension,
                         const Options3DL& options);

/// Reads a file back by the book with the library's own reader and compares it with the table that
/// was written, within the precision of the format.
///
/// @param path       where the file is now
/// @param name       what people call it
/// @param extension  the format that was written
/// @param options    what a .3dl file was written with
/// @param isByBook   whether the file's pre-LUT was written by the book too
/// @return           the largest deviation of a sample from the table, in the table's units
/// @throws Failure   the file cannot be read or differs; the text says where
double verify(const std::string& path, const std::string& name, const std::string& extension,
              const Orlith::LUT::LUT& table, const Options3DL& options, bool isByBook = true);

/// A deviation in two digits, rounded up: what is told is never below what is lost.
std::string deviationText(double deviation);

/// The line that says what was written.
/// @param outcome  of its verification
std::string summary(const std::string& name, const std::string& extension,
                    const Orlith::LUT::LUT& table, const std::string& outcome);

}  // namespace orlith
