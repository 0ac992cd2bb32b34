#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// Reads .3dl files of the Flame/Smoke, Lustre and Scratch dialects into a lattice, codes scaled to
/// 0 to 1.
///
/// Properties, none of which may be missing:
///   "format3DL"        String  auto (go by the file), flame, lustre or scratch
///   "outputBitDepth"   Int     bits of the output codes; -1 as the input codes, -2 go by the file
///   "normalizeOutput"  Int     1: values above 1 are scaled down until the largest is 1
class LUTFileReader3DL final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;
};

}  // namespace Orlith::LUT
