#include "lut/io/interchange/CSPInterchange.h"

#include "lut/FloatToInt.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kNoVersion[] = "CSP LUT reader: expecting version identifier CSPLUTV100.";
constexpr char kNoMoreShaper[] = "CSP LUT reader: expecting more pre-LUT data.";
constexpr char kShaperError[] =
    "CSP LUT reader: found different number of data elements than pre-LUT size specified.";
constexpr char kLatticeError[] =
    "CSP LUT reader: syntax error while reading 3D LUT data, expecting more data.";
constexpr char kCurveError[] =
    "CSP LUT reader: syntax error while reading LUT data, expecting more data.";

constexpr int kFewestPoints = 2;  // one point has no slope
constexpr const char* kChannels[] = {"red", "green", "blue"};

/// The shaper of one channel.
class ChannelRows {
public:
    ChannelRows(const LUT& lut, unsigned channel)
        : lut_(lut),
          channel_(channel),
          count_(static_cast<std::size_t>(toInt32(lut.inputShaper.counts[channel]))) {}

    std::size_t count() const { return count_; }
    float input(std::size_t i) const { return lut_.inputShaper.entries[i][channel_]; }
    float output(std::size_t i) const { return lut_.outputShaper.entries[i][channel_]; }

    /// Equal neighbours are a step; digits that a writer left off make them, too.
    bool rises() const {
        for (std::size_t i = 1; i < count_; ++i) {
            if (input(i) < input(i - 1)) return false;
        }
        return input(0) < input(count_ - 1);
    }

    bool leadsBeyondTable() const {
        constexpr float kLastDigit = 0.000001F;  // that files of this kind have
        for (std::size_t i = 0; i < count_; ++i) {
            if (output(i) < -kLastDigit || output(i) > 1.0F + kLastDigit) return true;
        }
        return false;
    }

    /// For a table that ends at 0 and 1.
    bool changesNothing() const {
        for (std::size_t i = 0; i < count_; ++i) {
            if (input(i) != output(i)) return false;
        }
        return input(0) <= 0.0F && input(count_ - 1) >= 1.0F;
    }

private:
    const LUT& lut_;
    unsigned channel_;
    std::size_t count_;
};

}  // namespace

const char* CSPInterchange::dataError() const {
    return isLattice_ ? kLatticeError : kCurveError;
}

bool CSPInterchange::isWhole(std::string_view& line) {
    if (isMetadata_) {
        isMetadata_ = line != "END METADATA";
        return !isMetadata_;
    }
    const bool isComment = begin_.empty() && !line.empty() && line.front() == '#';
    const bool goesOn = !isComment && !line.empty() && line.back() == '\\';
    if (begin_.empty() && !goesOn) return true;
    if (goesOn) line.remove_suffix(1);
    if (begin_.size() + line.size() >= LineSource::kLongestLine) {
        fail(dataError(), "a line goes on for more than 16 MiB");
    }
    begin_.append(line) += ' ';
    if (goesOn) return false;
    whole_.swap(begin_);
    begin_.clear();
    line = trim(whole_);
    return true;
}

/// The kind begins with a digit and is no number.
bool CSPInterchange::isVerbatim(std::string_view line) {
    if (hasKind_ || (line != "1D" && line != "3D")) return false;
    hasKind_ = true;
    isLattice_ = line == "3D";
    return true;
}

bool CSPInterchange::takeKeyword(std::string_view line) {
    if (!hasKind_) return true;
    if (!hasNumbers_ && line == "END METADATA") return true;
    isMetadata_ = !hasNumbers_ && line == "BEGIN METADATA";
    if (!isMetadata_) fail(dataError(), quoted(Tokens(line)[0]) + " is no number");
    return true;
}

bool CSPInterchange::takeNumbers(std::string_view line) {
    hasNumbers_ = true;
    if (stage_ == Stage::Shapers) {
        wordCount_ = countWords(line);
    } else if (stage_ == Stage::Size) {
        expectSize(line);
        stage_ = Stage::Samples;
    } else if (const std::size_t count = countWords(line); count != 3) {
        fail(dataError(), "a sample has three numbers, this line " + std::to_string(count));
    }
    return true;
}

/// How many words there have to be is the book's.
void CSPInterchange::expectSize(std::string_view line) {
    for (std::string_view word; takeWord(line, word);) {
        if (toInt(word) >= kFewestPoints) continue;
        fail(dataError(), "a table needs at least 2 points a side");
    }
}

void CSPInterchange::takeShapers(const LUT& lut) {
    stage_ = Stage::Size;
    bool changesNothing = true;
    for (unsigned c = 0; c < 3; ++c) {
        const ChannelRows rows(lut, c);
        const std::string name = std::string("the ") + kChannels[c] + " shaper";
        if (isMeant() && rows.count() < kFewestPoints) {
            fail(dataError(), name + " needs at least 2 points");
        }
        if (isMeant() && !rows.rises()) {
            fail(dataError(), "the input positions of " + name + " do not rise");
        }
        if (rows.leadsBeyondTable()) {
            remark("beyond", name + " leads beyond 0 to 1, where the table ends");
        }
        changesNothing = changesNothing && rows.changesNothing();
    }
    if (!isMeant() && lut.is1D() && !changesNothing) {
        remark("curve", "the shapers are not used: the curve covers 0 to 1");
    }
}

void CSPInterchange::watch(std::string_view line) {
    line = trim(line);
    if (stage_ == Stage::Shapers) {
        wordCount_ = countWords(line);
        if (line == "BEGIN METADATA") isMetadata_ = true;
        if (line == "END METADATA") isMetadata_ = false;
    } else if (stage_ == Stage::Size) {
        if (!line.empty()) stage_ = Stage::Samples;
    } else if (line.empty()) {
        remark("blank", "the blank line is taken for a sample");
    } else if (line.front() == '#') {
        remark("comment", "the comment is taken for a sample");
    }
}

std::string CSPInterchange::reasonOf(std::string_view message, std::string_view lastLine) {
    if (message == kNoVersion && !lastLine.empty() &&
        lastLine.find("CSPLUTV100") == std::string_view::npos) {
        return quoted(trim(lastLine)) + " is not \"CSPLUTV100\"";
    }
    if (message == kNoMoreShaper) {
        return isMetadata_ ? "\"END METADATA\" is missing" : "the file ends within the shapers";
    }
    if (message == kShaperError) {
        return "the line has " + std::to_string(wordCount_) +
               " numbers, its shaper another count of points";
    }
    return "";
}

}  // namespace Orlith::LUT
