#pragma once

#include <string>

#include "lut/LUT.h"
#include "orlith/WriteOptions.h"

namespace orlith {

/// What reading a written file back showed.
struct Verification {
    bool isVerified = false;
    std::string reason;             ///< why it was not
    double largestDeviation = 0.0;  ///< of a sample from the table, in the table's units
};

/// Why a file of a table, which the format's writer takes, could not be read again; empty if it
/// can.
std::string whyUnreadable(const std::string& extension, const Orlith::LUT::LUT& table);

/// Reads a file back with the library's own reader and compares it with the table that was written,
/// within the precision of the format.
///
/// @param path       where the file is now
/// @param name       what people call it
/// @param extension  the format that was written
/// @param options    what a .3dl file was written with
/// @throws Failure   the file cannot be read or differs; the text says where
Verification verify(const std::string& path, const std::string& name, const std::string& extension,
                    const Orlith::LUT::LUT& table, const Options3DL& options);

/// The line that says what was written.
std::string summary(const std::string& name, const std::string& extension,
                    const Orlith::LUT::LUT& table, const Verification& verification);

}  // namespace orlith
