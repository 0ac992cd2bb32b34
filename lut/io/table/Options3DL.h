#pragma once

#include <string>

#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// How a .3dl file is written; other formats ignore it.
struct Options3DL {
    int inputBits = 10;
    int outputBits = 10;
    bool clampOutput = true;
    std::string dialect = "flame";
    float scale = 1.0F;
    float offset = 0.0F;
};

/// What the programs of a dialect multiply their codes by, and then add.
double ownScale(const std::string& dialect);
double ownOffset(const std::string& dialect);

/// Hands the options to a writer as its properties.
void setWriterProperties(LUTFileWriter& writer, const Options3DL& options);

/// The code that a .3dl writer aims at for a value, before rounding.
double codeOf(double value, const Options3DL& options);

}  // namespace Orlith::LUT
