#pragma once

#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// Writes Nucoda tables, .cms: a lattice of equal sides with an outputShaper, its pre-LUT.
class LUTFileWriterCMS final : public LUTFileWriter {
public:
    void write(const std::string& filename, const boost::shared_ptr<LUT>& lut) override;
};

}  // namespace Orlith::LUT
