#pragma once

#include <cstdint>

#include "lut/io/interchange/TextInterchange.h"

namespace Orlith::LUT {

/// What other programs' .vf files are, beside their book.
///
///   # comment                     but for the first line, which names the kind of file
///   grid_size 33 33 33
///   global_transform ...          steps of 1/N, as printed: N points from 0 to 1
///   data                          no placement of the grid at all: from 0 to 1 as well
///   ...
///   }                             ends the file
class VFInterchange final : public TextInterchange {
public:
    using TextInterchange::TextInterchange;

    /// Looks at the table that the reader has made.
    /// @throws Exception  it is not what the file says
    void finish(LUT& lut, LineSource& lines);

protected:
    const char* dataError() const override;
    bool isVerbatim(std::string_view line) override;
    bool isEnd(std::string_view line) override { return line == "}"; }
    bool takeKeyword(std::string_view line) override;
    void watch(std::string_view line) override;
    std::string reasonOf(std::string_view message, std::string_view lastLine) override;

private:
    bool takeParameter(std::string_view line);

    bool hasHeader_ = false;
    int keywordCount_ = 0;
    bool hasData_ = false;       // the line "data" has come
    bool hasPlacement_ = false;  // of the grid
    std::uint64_t points_ = 0;   // of the latest grid_size
};

}  // namespace Orlith::LUT
