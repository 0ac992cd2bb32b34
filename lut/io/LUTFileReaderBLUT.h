#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// Reads binary LUTs, .blut: a lattice of equal sides or a curve, as floats or halves.
class LUTFileReaderBLUT final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;
};

}  // namespace Orlith::LUT
