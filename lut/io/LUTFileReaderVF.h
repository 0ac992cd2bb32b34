#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// Reads vector fields, .vf, .vfz and .gz: a lattice. Whether a file is compressed shows in its
/// first bytes, whatever its name.
class LUTFileReaderVF final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;
};

}  // namespace Orlith::LUT
