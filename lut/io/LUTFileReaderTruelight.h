#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// Reads Truelight cubes, .cub: a lattice and, where there is one, its input LUT as outputShaper.
class LUTFileReaderTruelight final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;
};

}  // namespace Orlith::LUT
