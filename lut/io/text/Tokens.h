#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

namespace Orlith::LUT {

/// Takes white space (blank, tab, line feed, vertical tab, form feed, carriage return) off both
/// ends, or off the end alone.
std::string_view trim(std::string_view text);
std::string_view trimEnd(std::string_view text);

/// Takes the next word off a text. Words are separated by runs of blanks and tabs.
/// @return false, leaving word alone, if there is none
bool takeWord(std::string_view& text, std::string_view& word);

std::size_t countWords(std::string_view text);

/// The first words of a line. Only so many are kept, since a line can hold millions; a row of
/// numbers is walked by takeWord.
class Tokens {
public:
    /// One more than the longest line of words has that any format knows, so that too many show.
    static constexpr std::size_t kMost = 18;

    Tokens() = default;
    explicit Tokens(std::string_view line) { add(line); }

    /// Replaces the words by those of another line, which has to outlive their use.
    void split(std::string_view line) {
        words_.clear();
        add(line);
    }

    /// Puts the words of another line behind those that are there.
    void add(std::string_view line) {
        for (std::string_view word; words_.size() < kMost && takeWord(line, word);)
            words_.push_back(word);
    }

    /// kMost at most.
    std::size_t count() const { return words_.size(); }
    bool empty() const { return words_.empty(); }

    /// Word i; an empty text, which converts to 0, where there are not so many.
    std::string_view operator[](std::size_t i) const {
        return i < words_.size() ? words_[i] : std::string_view();
    }

private:
    std::vector<std::string_view> words_;
};

}  // namespace Orlith::LUT
