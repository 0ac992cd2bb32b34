#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr std::string_view kSpace = " \t\n\v\f\r";

bool isSeparator(char c) {
    return c == ' ' || c == '\t';
}

}  // namespace

std::string_view trim(std::string_view text) {
    const std::size_t first = text.find_first_not_of(kSpace);
    return first == std::string_view::npos ? std::string_view() : trimEnd(text.substr(first));
}

std::string_view trimEnd(std::string_view text) {
    return text.substr(0, text.find_last_not_of(kSpace) + 1);  // npos + 1 is 0
}

bool takeWord(std::string_view& text, std::string_view& word) {
    const char* at = text.data();
    const char* const end = at + text.size();
    while (at != end && isSeparator(*at))
        ++at;
    if (at == end) return false;
    const char* const start = at;
    while (at != end && !isSeparator(*at))
        ++at;
    word = {start, static_cast<std::size_t>(at - start)};
    text = {at, static_cast<std::size_t>(end - at)};
    return true;
}

std::size_t countWords(std::string_view text) {
    std::size_t count = 0;
    for (std::string_view word; takeWord(text, word);)
        ++count;
    return count;
}

}  // namespace Orlith::LUT
