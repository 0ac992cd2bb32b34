#pragma once

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

class CMSInterchange;
class LineSource;

/// Reads Nucoda tables, .cms: a lattice of equal sides behind a pre-LUT, which goes to the table's
/// outputShaper.
class LUTFileReaderCMS final : public LUTFileReader {
public:
    boost::shared_ptr<LUT> read(const std::string& filename) override;

private:
    void readTable(LineSource& lines, const CMSInterchange& meant);
};

}  // namespace Orlith::LUT
