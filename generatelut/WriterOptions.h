#pragma once

#include "lut/io/LUTFileWriter.h"

namespace generatelut {

/// The .3dl controls, as menu indices.
struct Options3DL {
    int bitDepth;
    int outputBitDepth;
    bool clampOutput;
    int format;
};

/// Hands the .3dl controls to a writer as its properties "inputBitDepth", "outputBitDepth",
/// "clampOutput", "format3DL" and, for Scratch, "scale" and "offset".
void setWriterOptions(Orlith::LUT::LUTFileWriter& writer, const Options3DL& options);

}  // namespace generatelut
