#pragma once

#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// Writes Truelight cubes, .cub: a lattice and its outputShaper, if it has one, as input LUT.
class LUTFileWriterTruelight final : public LUTFileWriter {
public:
    void write(const std::string& filename, const boost::shared_ptr<LUT>& lut) override;
};

}  // namespace Orlith::LUT
