#pragma once

#include <boost/optional/optional.hpp>

#include "lut/io/interchange/TextInterchange.h"

namespace Orlith::LUT {

/// What other programs' .cms files are, beside their book.
///
///   LUT_3D_SIZE 33
///   LUT_3D_INPUT_RANGE 0 1    the domain of a file without a pre-LUT
///                             no LUT_1D_SIZE: there is no pre-LUT, and samples come at once
///   WORDS ...                 anything else that begins with a letter means nothing
class CMSInterchange final : public TextInterchange {
public:
    using TextInterchange::TextInterchange;

    /// Whether data begin with a pre-LUT. By the book they always do.
    bool hasPreLUT() const { return !isMeant() || preLUTSize_ > 0; }

    /// Looks at the table that the reader has made.
    /// @throws Exception  it is not what the file says
    void finish(LUT& lut, LineSource& lines);

protected:
    const char* dataError() const override;
    bool takeKeyword(std::string_view line) override;
    void watch(std::string_view line) override;
    std::string reasonOf(std::string_view message, std::string_view lastLine) override;

private:
    int preLUTSize_ = 0;  // of the latest size lines; 0: none
    int latticeSize_ = 0;
    boost::optional<Range> range_;
};

}  // namespace Orlith::LUT
