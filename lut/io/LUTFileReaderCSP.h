#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// Reads cineSpace tables, .csp: a lattice or a curve, with a shaper for each channel.
class LUTFileReaderCSP final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;
};

}  // namespace Orlith::LUT
