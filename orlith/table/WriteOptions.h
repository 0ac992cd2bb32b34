#pragma once

#include <optional>
#include <string>
#include <vector>

#include "lut/LUT.h"
#include "lut/io/table/Options3DL.h"

namespace CLI {
class App;
}  // namespace CLI

namespace orlith {

using Orlith::LUT::Options3DL;

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

/// Gives a table without a pre-LUT the ramp that lut1d and style1d ask for, if they do.
void addPreLUT(Orlith::LUT::LUT& lut, const WriteOptions& options);

/// Makes a ramp from 0 to 1 the outputShaper of a table, as the operator does.
void setPreLUT(Orlith::LUT::LUT& lut, int entryCount, const std::string& style);

/// The bit depths that a .3dl file is written with, as the command line has them.
const std::vector<std::string>& bitDepthWords();

}  // namespace orlith
