#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// Reads Nucoda tables, .cms: a lattice of equal sides behind a pre-LUT, which goes to the table's
/// outputShaper.
class LUTFileReaderCMS final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;
};

}  // namespace Orlith::LUT
