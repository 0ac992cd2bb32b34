#pragma once

#include <CLI/CLI.hpp>
#include <optional>
#include <string>
#include <vector>

#include "lut/LUT.h"
#include "lut/io/LUTFileWriter.h"

namespace orlith {

/// The options of a .3dl writer, which other formats ignore.
struct Options3DL {
    int inputBits = 10;
    int outputBits = 10;
    bool clampOutput = true;
    std::string dialect = "flame";
    float scale = 1.0F;
    float offset = 0.0F;
};

/// How a table file is written.
struct WriteOptions {
    int bitDepth = 10;
    int outputBitDepth = 0;  ///< 0: as bitDepth
    bool clampOutput = true;
    std::string format3DL = "flame";
    std::optional<double> scale;
    std::optional<double> offset;
    std::optional<int> lut1d;
    std::optional<std::string> style1d;

    /// Whether a pre-LUT is asked for, for a table that has none.
    bool hasPreLUT() const { return lut1d || style1d; }

    /// Scale and offset as the dialect brings them, unless they are given.
    Options3DL options3DL() const;
};

void addWriteOptions(CLI::App& command, WriteOptions& options);

/// Hands the options to a writer as its properties.
void setWriterProperties(Orlith::LUT::LUTFileWriter& writer, const Options3DL& options);

/// Gives a table without a pre-LUT the ramp that lut1d and style1d ask for, if they do.
void addPreLUT(Orlith::LUT::LUT& lut, const WriteOptions& options);

/// Makes a ramp from 0 to 1 the outputShaper of a table, as the operator does.
void setPreLUT(Orlith::LUT::LUT& lut, int entryCount, const std::string& style);

/// The bit depths that a .3dl file is written with, as the command line has them.
const std::vector<std::string>& bitDepthWords();

}  // namespace orlith
