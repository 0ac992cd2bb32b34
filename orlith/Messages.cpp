#include "orlith/Messages.h"

#include <fmt/format.h>

#include <cstdio>
#include <iterator>

namespace orlith {
namespace {

bool isControl(unsigned char byte) {
    return byte < 0x20 || byte == 0x7f;
}

void printLine(const char* kind, const std::string& text) {
    const std::string line = fmt::format("orlith: {}: {}\n", kind, printable(text));
    std::fputs(line.c_str(), stderr);
}

}  // namespace

std::string printable(std::string_view text) {
    std::string shown;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const auto byte = static_cast<unsigned char>(text[i]);
        // The control characters of Latin-1, as UTF-8 writes them: 0xc2 and 0x80 to 0x9f.
        const bool isLatinControl = byte == 0xc2 && i + 1 < text.size() &&
                                    (static_cast<unsigned char>(text[i + 1]) & 0xe0U) == 0x80U;
        if (text[i] == '\n') {
            shown += "\\n";
        } else if (text[i] == '\t') {
            shown += "\\t";
        } else if (text[i] == '\r') {
            shown += "\\r";
        } else if (isControl(byte)) {
            fmt::format_to(std::back_inserter(shown), "\\x{:02x}", byte);
        } else if (isLatinControl) {
            fmt::format_to(std::back_inserter(shown), "\\x{:02x}",
                           static_cast<unsigned char>(text[++i]));
        } else {
            shown += text[i];
        }
    }
    return shown;
}

void printError(const std::string& text) {
    printLine("error", text);
}

void warn(const std::string& text) {
    printLine("warning", text);
}

}  // namespace orlith
