#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {

std::string_view trim(std::string_view text) {
    constexpr std::string_view kSpace = " \t\n\v\f\r";
    const std::size_t first = text.find_first_not_of(kSpace);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(kSpace) - first + 1);
}

void Tokens::split(std::string_view line, std::size_t mostWords) {
    tokens_.clear();
    const char* at = line.data();
    const char* const end = at + line.size();
    const auto isSeparator = [](char c) { return c == ' ' || c == '\t'; };
    while (tokens_.size() < mostWords) {
        while (at != end && isSeparator(*at))
            ++at;
        if (at == end) return;
        const char* const start = at;
        while (at != end && !isSeparator(*at))
            ++at;
        tokens_.emplace_back(start, static_cast<std::size_t>(at - start));
    }
}

}  // namespace Orlith::LUT
