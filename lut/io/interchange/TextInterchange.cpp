#include "lut/io/interchange/TextInterchange.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <system_error>

#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr std::string_view kByteOrderMark = "\xef\xbb\xbf";
constexpr char kReturnsAlone[] = "the lines of the file end in carriage returns alone";

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

/// Whether a whole word is a number, finite or not. What is too small or too large for double
/// precision is one as well; toFloat gives 0 or infinity for it.
bool isNumber(std::string_view word) {
    if (word.size() > 1 && word[0] == '+' && word[1] != '-') word.remove_prefix(1);
    double number = 0.0;
    const char* const end = word.data() + word.size();
    const auto result = std::from_chars(word.data(), end, number);
    return result.ec != std::errc::invalid_argument && result.ptr == end;
}

/// Whether the first word of a line begins with a letter and is no number, as "inf" is.
bool beginsWithAWord(std::string_view line) {
    std::string_view word;
    return takeWord(line, word) && isLetter(word[0]) && !isNumber(word);
}

}  // namespace

std::string quoted(std::string_view word) {
    constexpr std::size_t kMost = 40;
    std::string text = "\"";
    for (const char c : word.substr(0, kMost)) {
        if (c == '\r') {
            text += "\\r";
        } else if (static_cast<unsigned char>(c) < 0x20 || c == 0x7f) {
            text += '?';
        } else {
            text += c;
        }
    }
    return text + (word.size() > kMost ? "...\"" : "\"");
}

std::string endsEarly(std::uint64_t sampleCount, std::uint64_t points) {
    return "the file ends after " + std::to_string(sampleCount) + " of " + std::to_string(points) +
           " samples";
}

bool TextInterchange::pass(std::string_view& line) {
    if (isOver_) return false;
    constexpr std::size_t kMostKept = 200;
    lastLine_.assign(line.substr(0, kMostKept));
    lastLineNumber_ = lineNumber();
    if (isMeant()) return passMeant(line);
    watch(line);
    return true;
}

bool TextInterchange::passMeant(std::string_view& line) {
    if (lineNumber() == 1 && line.substr(0, kByteOrderMark.size()) == kByteOrderMark) {
        line.remove_prefix(kByteOrderMark.size());
    }
    line = trim(line);
    if (!isWhole(line)) return false;
    if (isVerbatim(line)) return true;
    if (line.empty()) return false;
    if (line[0] == '#') {
        putMarkApart(line);
        isOver_ = isEnd(line);
        return !isOver_ && takeComment(line);
    }
    line = trimEnd(line.substr(0, line.find('#')));
    isOver_ = isEnd(line);
    if (isOver_) return false;
    if (line.find(',') != std::string_view::npos) replaceDecimalCommas(line);
    if (beginsWithAWord(line)) return takeKeyword(line);
    expectNumbers(line);
    return takeNumbers(line);
}

void TextInterchange::putMarkApart(std::string_view& line) {
    if (line.size() == 1 || line[1] == ' ' || line[1] == '\t') return;
    rewritten_.assign("# ").append(line.substr(1));
    line = rewritten_;
}

void TextInterchange::replaceDecimalCommas(std::string_view& line) {
    rewritten_.clear();
    rewritten_.reserve(line.size());
    for (std::string_view rest = line, word; takeWord(rest, word);) {
        if (!rewritten_.empty()) rewritten_ += ' ';
        const std::size_t start = rewritten_.size();
        rewritten_ += word;
        if (hasDecimalComma(word)) rewritten_[rewritten_.find(',', start)] = '.';
    }
    line = rewritten_;
}

void TextInterchange::expectNumbers(std::string_view line) {
    for (std::string_view word; takeWord(line, word);) {
        if (!isNumber(word)) fail(dataError(), quoted(word) + " is no number");
        if (!std::isfinite(toFloat(word))) fail(dataError(), quoted(word) + " is not finite");
    }
}

void TextInterchange::expectOwnFormat(std::string_view line) {
    static constexpr struct {
        std::string_view line;
        const char* format;
    } kMarks[] = {{"LUT_1D_SIZE", ".cube"},
                  {"LUT_3D_SIZE", ".cube"},
                  {"NUCODA_3D_CUBE", ".cms"},
                  {"# Truelight Cube", ".cub"}};
    for (const auto& mark : kMarks) {
        if (line.substr(0, mark.line.size()) != mark.line) continue;
        fail(dataError(), quoted(mark.line) + " tells a " + mark.format + " file by another name");
    }
}

void TextInterchange::remarkUnknown(std::string_view line, const std::string& more) {
    expectOwnFormat(line);
    const Tokens words(line);
    // Among samples it is one that is misspelt.
    if (sampleCount() > 0 && words.count() == 3 && isNumber(words[1]) && isNumber(words[2])) {
        expectNumbers(line);
    }
    remark("unknown", quoted(words[0]) + " is not known and not used" + more);
}

RGB TextInterchange::expectNumbersBehind(std::string_view line, std::size_t count) {
    std::string_view keyword;
    takeWord(line, keyword);
    expectNumbers(line);
    const Tokens words(line);
    if (words.count() != count) {
        fail(dataError(), quoted(keyword) + " needs " + std::to_string(count) + " numbers, has " +
                              std::to_string(words.count()));
    }
    return {toFloat(words[0]), toFloat(words[1]), toFloat(words[2])};
}

int TextInterchange::expectSize(std::string_view word, const char* message) {
    constexpr int kFewestPoints = 2;  // one point has no slope
    if (word.empty() || !std::all_of(word.begin(), word.end(), isDigit) || word.size() > 9) {
        fail(message, quoted(word) + " is no size");
    }
    const int size = toInt(word);
    if (size < kFewestPoints) fail(message, "a table needs at least 2 points a side");
    return size;
}

void TextInterchange::expectRising(const Range& range) {
    if (!rises(range)) fail(dataError(), "the domain does not rise");
}

Range TextInterchange::expectRangeBehind(std::string_view line) {
    const RGB ends = expectNumbersBehind(line, 2);
    const Range range{RGB(ends[0], ends[0], ends[0]), RGB(ends[1], ends[1], ends[1])};
    expectRising(range);
    return range;
}

void TextInterchange::expectAllSamples(const LUT& lut, LineSource& lines) {
    if (!isMeant()) return;
    std::string_view line;
    const bool hasSurplus = lines.next(line);
    const std::uint64_t points = pointCount(lut);
    if (hasSurplus || sampleCount() > points) {
        fail(dataError(),
             "there are more samples than the " + std::to_string(points) + " of the table");
    }
    if (sampleCount() < points) fail(dataError(), endReason());
}

void TextInterchange::fail(const char* message, const std::string& reason) {
    reading_.remarks.addLast(lineNumber(), hasReturnsForLineEnds() ? kReturnsAlone : reason);
    isExplained_ = true;
    throw Exception(message);
}

std::string TextInterchange::endReason() const {
    const bool hasTable = reading_.table && reading_.table.get() != oldTable_;
    return endReason(hasTable ? pointCount(*reading_.table) : 0);
}

std::string TextInterchange::endReason(std::uint64_t points) const {
    return points == 0 ? "the file ends here" : endsEarly(sampleCount(), points);
}

/// Such a file is one line: as programs wrote it long ago.
bool TextInterchange::hasReturnsForLineEnds() const {
    return lineNumber() == 1 && trim(lastLine_).find('\r') != std::string_view::npos;
}

void TextInterchange::explain(const char* message) {
    if (isExplained_) return;
    std::string reason = hasReturnsForLineEnds() ? kReturnsAlone : reasonOf(message, lastLine_);
    if (reason.empty() && isAtEnd_) reason = endReason();
    if (reason.empty() && lastLineNumber_ != lineNumber()) {
        reason = "what is missing should come before this line of three numbers";
    }
    if (reason.empty() && lastLine_.rfind(kByteOrderMark, 0) == 0) {
        reason = "the file begins with a byte order mark";
    }
    if (reason.empty() && lastLine_ == "\r") reason = "the line holds only a carriage return";
    const bool isComment = lastLine_.size() > 1 && lastLine_[0] == '#';
    if (reason.empty() && (isComment || beginsWithAWord(lastLine_))) {
        std::string_view rest = lastLine_;
        std::string_view word;
        takeWord(rest, word);
        reason = "the line begins with " + quoted(word) + " and is taken for data";
    }
    if (reason.empty()) {
        reason = "the line has " + std::to_string(countWords(lastLine_)) +
                 " words: " + quoted(lastLine_);
    }
    reading_.remarks.addLast(lineNumber(), reason);
}

}  // namespace Orlith::LUT
