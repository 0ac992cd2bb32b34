#pragma once

#include "lut/io/interchange/TextInterchange.h"

namespace Orlith::LUT {

/// What other programs' .cub files are, beside their book.
///
///   #width 2 2 2         keywords, with or without a blank behind the mark, if all that belongs to
///                        them stands in the line and nothing else
///   # cube of a print    a comment, whatever it begins with
class TruelightInterchange final : public TextInterchange {
public:
    using TextInterchange::TextInterchange;

    /// Looks at the table that the reader has made.
    /// @throws Exception  it is not what the file says
    void finish(LUT& lut, LineSource& lines);

protected:
    const char* dataError() const override;
    bool isEnd(std::string_view line) override;
    bool takeComment(std::string_view line) override;
    bool takeKeyword(std::string_view line) override;
    void watch(std::string_view line) override;
    std::string reasonOf(std::string_view message, std::string_view lastLine) override;

private:
    bool hasWidth_ = false;
    bool hasLength_ = false;
};

}  // namespace Orlith::LUT
