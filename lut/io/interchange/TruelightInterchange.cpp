#include "lut/io/interchange/TruelightInterchange.h"

#include <boost/algorithm/string/predicate.hpp>
#include <locale>

#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kDataError[] =
    "Truelight LUT reader: syntax error while reading LUT data (too many or not enough values).";
constexpr char kWidthError[] = "Truelight LUT reader: expected 3 values for width.";

bool isKeyword(std::string_view word, const char* keyword) {
    return boost::algorithm::iequals(word, keyword, std::locale::classic());
}

bool beginsWithADigit(std::string_view word) {
    return !word.empty() && word[0] >= '0' && word[0] <= '9';
}

}  // namespace

const char* TruelightInterchange::dataError() const {
    return kDataError;
}

bool TruelightInterchange::isEnd(std::string_view line) {
    const Tokens words(line);
    return words[0] == "#" && words.count() == 2 && isKeyword(words[1], "end");
}

bool TruelightInterchange::takeComment(std::string_view line) {
    const Tokens words(line);
    if (isKeyword(words[1], "inputlut") || isKeyword(words[1], "cube")) return words.count() == 2;
    // Those with values are comments if none follows: "# width of the table".
    if (!beginsWithADigit(words[2])) return false;
    const bool isWidth = isKeyword(words[1], "width");
    if (!isWidth && !isKeyword(words[1], "lutlength")) return false;

    bool& isThere = isWidth ? hasWidth_ : hasLength_;
    if (isThere) fail(kDataError, "a second line " + quoted(words[1]));
    isThere = true;
    if (!isWidth) {
        if (words[2] != "0") expectSize(words[2], kDataError);
        return true;
    }
    if (words.count() != 5) {
        fail(kWidthError, "a width needs 3 numbers, has " + std::to_string(words.count() - 2));
    }
    for (std::size_t i = 2; i < 5; ++i)
        expectSize(words[i], kWidthError);
    return true;
}

bool TruelightInterchange::takeKeyword(std::string_view line) {
    remarkUnknown(line);
    return false;
}

void TruelightInterchange::finish(LUT& lut, LineSource& lines) {
    expectAllSamples(lut, lines);
    if (!isMeant()) return;
    const std::size_t entryCount = lut.outputShaper.entries.size();
    const auto length = static_cast<std::size_t>(lut.outputShaper.counts[0]);
    if (hasLength_ && length != entryCount) {
        fail(kDataError, "the input LUT has " + std::to_string(entryCount) + " of " +
                             std::to_string(length) + " entries");
    }
    if (entryCount == 1) fail(kDataError, "an input LUT needs at least 2 entries");
    lut.outputShaper.counts.fill(static_cast<float>(entryCount));
}

void TruelightInterchange::watch(std::string_view line) {
    const Tokens words(line);
    if (words[0] != "#" || words.count() != 2 || words[1].back() != '\r') return;
    const std::string_view keyword = trimEnd(words[1]);
    if (isKeyword(keyword, "inputlut") || isKeyword(keyword, "cube") || isKeyword(keyword, "end")) {
        remark("return", quoted(words[1]) + " is not known for its carriage return, and not used");
    }
}

std::string TruelightInterchange::reasonOf(std::string_view message, std::string_view) {
    const bool isOutside = message == kDataError && isMeant() && !hasWidth_;
    return isOutside ? "the line \"# width\" has to come before the data" : "";
}

}  // namespace Orlith::LUT
