#pragma once

#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// Writes vector fields, .vf: a lattice of equal sides. Never compressed, also under .vfz and .gz.
class LUTFileWriterVF final : public LUTFileWriter {
public:
    void write(const std::string& filename, const boost::shared_ptr<LUT>& lut) override;
};

}  // namespace Orlith::LUT
