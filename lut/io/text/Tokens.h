#pragma once

#include <cstddef>
#include <limits>
#include <string_view>
#include <vector>

namespace Orlith::LUT {

/// Takes white space (blank, tab, line feed, vertical tab, form feed, carriage return) off both
/// ends.
std::string_view trim(std::string_view text);

/// The words of a line, separated by runs of blanks and tabs.
class Tokens {
public:
    Tokens() = default;
    explicit Tokens(std::string_view line) { split(line); }

    /// Replaces the words by those of another line, which has to outlive their use.
    /// @param mostWords  stop after so many: one more than can be used, where a line may hold
    ///                   millions that only their count could refuse
    void split(std::string_view line,
               std::size_t mostWords = std::numeric_limits<std::size_t>::max());

    std::size_t count() const { return tokens_.size(); }
    bool empty() const { return tokens_.empty(); }

    /// Word i; an empty text, which converts to 0, where there are not so many.
    std::string_view operator[](std::size_t i) const {
        return i < tokens_.size() ? tokens_[i] : std::string_view();
    }

private:
    std::vector<std::string_view> tokens_;
};

}  // namespace Orlith::LUT
