#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

class LineSource;

/// Reads Truelight cubes, .cub: a lattice and, where there is one, its input LUT as outputShaper.
class LUTFileReaderTruelight final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;

private:
    boost::shared_ptr<LUT> readTable(LineSource& lines);
};

}  // namespace Orlith::LUT
