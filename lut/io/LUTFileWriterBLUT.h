#pragma once

#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// Writes binary LUTs, .blut: a lattice of equal sides, as floats.
///
/// A side of more than 127 points does not read back; that is not checked.
class LUTFileWriterBLUT final : public LUTFileWriter {
public:
    void write(const std::string& filename, const boost::shared_ptr<LUT>& lut) override;
};

}  // namespace Orlith::LUT
