#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// Reads Iridas cubes, .cube and .itx: a lattice or a curve.
class LUTFileReaderIridas final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;
};

}  // namespace Orlith::LUT
