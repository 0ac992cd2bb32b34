#pragma once

#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// Writes integer .3dl files: a lattice of equal sides, 2 to 65 points each.
///
/// Properties: "format3DL" (String: flame, lustre or scratch), "inputBitDepth", "outputBitDepth",
/// "clampOutput" (Int), and, with 1 and 0 as defaults, "scale" and "offset" (Double) of the output
/// codes.
class LUTFileWriter3DL final : public LUTFileWriter {
public:
    void write(const std::string& filename, const boost::shared_ptr<LUT>& lut) override;
};

}  // namespace Orlith::LUT
