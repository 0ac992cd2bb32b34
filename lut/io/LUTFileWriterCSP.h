#pragma once

#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// Writes cineSpace tables, .csp: a lattice of any sides or a curve, with its shapers; identity
/// shapers for a table that lacks either of them.
class LUTFileWriterCSP final : public LUTFileWriter {
public:
    void write(const std::string& filename, const boost::shared_ptr<LUT>& lut) override;
};

}  // namespace Orlith::LUT
