#include "host/Text.h"

namespace host {
namespace {

constexpr std::string_view kBlanks = " \t\r\n\v\f";

}  // namespace

std::string_view trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::string oneLine(std::string_view text) {
    std::string line;
    while (!text.empty()) {
        const std::size_t end = text.find_first_of("\r\n");
        const std::string_view part = trimmed(text.substr(0, end));
        if (!line.empty() && !part.empty()) line += ' ';
        line += part;
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    }
    return line;
}

std::string firstLine(std::string_view text) {
    text = trimmed(text);
    return std::string(trimmed(text.substr(0, text.find_first_of("\r\n"))));
}

}  // namespace host
