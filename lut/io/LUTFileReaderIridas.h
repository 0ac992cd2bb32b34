#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

class LineSource;

/// Reads Iridas cubes, .cube and .itx: a lattice or a curve.
class LUTFileReaderIridas final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;

private:
    boost::shared_ptr<LUT> readTable(LineSource& lines);
};

}  // namespace Orlith::LUT
