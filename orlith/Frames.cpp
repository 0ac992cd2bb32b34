#include "orlith/Frames.h"

#include <fmt/format.h>

#include <regex>

#include "orlith/Options.h"

namespace orlith {
namespace {

const std::regex& numberPlace() {
    static const std::regex place("%(?:0([0-9]{1,2}))?d|#+");
    return place;
}

}  // namespace

std::optional<Frames> parseFrames(const std::string& word) {
    static const std::regex range("([0-9]+)(?:-([0-9]+)(?:x([0-9]+))?)?");
    std::smatch parts;
    if (!std::regex_match(word, parts, range)) return {};
    Frames frames;
    if (!parseInteger(parts.str(1), frames.first)) return {};
    frames.last = frames.first;
    if (parts[2].matched && !parseInteger(parts.str(2), frames.last)) return {};
    if (parts[3].matched && !parseInteger(parts.str(3), frames.step)) return {};
    if (frames.last < frames.first || frames.step < 1) return {};
    return frames;
}

bool hasFrameNumber(const std::string& pattern) {
    return std::regex_search(pattern, numberPlace());
}

std::string frameName(const std::string& pattern, int frame) {
    std::string name;
    auto rest = pattern.begin();
    for (std::sregex_iterator place(pattern.begin(), pattern.end(), numberPlace()), end;
         place != end; ++place) {
        name.append(rest, (*place)[0].first);
        rest = (*place)[0].second;
        const bool isSharps = *(*place)[0].first == '#';
        int digits = isSharps ? static_cast<int>(place->length()) : 0;
        if ((*place)[1].matched) parseInteger(place->str(1), digits);
        name += fmt::format("{:0{}}", frame, digits);
    }
    return name.append(rest, pattern.end());
}

}  // namespace orlith
