#include "lut/io/interchange/CubeInterchange.h"

#include <algorithm>
#include <cstddef>
#include <string>

#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kDataError[] = "Iridas LUT reader: syntax error while reading LUT data.";
constexpr char kSizeError[] = "Iridas LUT reader: syntax error while reading LUT size.";
constexpr char kNoTable[] = "Iridas LUT reader: LUT failed to initialise.";

/// Whether a word is one of the format's but for its letters' case.
bool isKeywordInSmallLetters(std::string_view word) {
    std::string capitals(word);
    for (char& c : capitals) {
        if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
    }
    constexpr const char* kKeywords[] = {"LUT_1D_SIZE",        "LUT_3D_SIZE", "LUT_1D_INPUT_RANGE",
                                         "LUT_3D_INPUT_RANGE", "DOMAIN_MIN",  "DOMAIN_MAX"};
    return std::find(std::begin(kKeywords), std::end(kKeywords), capitals) != std::end(kKeywords);
}

}  // namespace

const char* CubeInterchange::dataError() const {
    return kDataError;
}

bool CubeInterchange::wantsPlainTriples() const {
    return isMeant() && latticeSize_ > 0 && shaper_.size() < static_cast<std::size_t>(curveSize_);
}

template <class Statement>
void CubeInterchange::take(boost::optional<Statement>& statement, std::string_view keyword,
                           const Statement& stated) {
    if (statement) remark("again", quoted(keyword) + " is stated again: this one is used");
    statement = stated;
}

bool CubeInterchange::takeKeyword(std::string_view line) {
    const Tokens words(line);
    const std::string_view keyword = words[0];
    if (keyword == "TITLE") return false;
    if (keyword == "LUT_1D_SIZE" || keyword == "LUT_3D_SIZE") {
        const bool isCurve = keyword == "LUT_1D_SIZE";
        int& size = isCurve ? curveSize_ : latticeSize_;
        if (size != 0 || sampleCount() > 0) fail(kSizeError, "a second size line");
        size = expectSize(words[1], kSizeError);
        // The lattice is the table, and the curve its shaper, whichever comes first.
        return !(isCurve && latticeSize_ > 0);
    }
    if (keyword == "DOMAIN_MIN") {
        take(domainMin_, keyword, expectNumbersBehind(line, 3));
    } else if (keyword == "DOMAIN_MAX") {
        take(domainMax_, keyword, expectNumbersBehind(line, 3));
    } else if (keyword == "LUT_1D_INPUT_RANGE") {
        take(curveRange_, keyword, expectRangeBehind(line));
    } else if (keyword == "LUT_3D_INPUT_RANGE") {
        take(latticeRange_, keyword, expectRangeBehind(line));
    } else {
        const char* const why =
            isKeywordInSmallLetters(keyword) ? ": keywords are in capital letters" : "";
        remarkUnknown(line, why);
    }
    return false;
}

bool CubeInterchange::takeNumbers(std::string_view line) {
    if (!wantsPlainTriples()) return true;
    const Tokens words(line);
    if (words.count() != 3) fail(kDataError, "a line of the 1D block needs three numbers");
    shaper_.push_back(RGB(toFloat(words[0]), toFloat(words[1]), toFloat(words[2])));
    return false;
}

void CubeInterchange::finish(LUT& lut, LineSource& lines) {
    expectAllSamples(lut, lines);
    if (!isMeant()) return;
    const bool hasShaper = latticeSize_ > 0 && curveSize_ > 0;
    // The domain of a file is that of its first block.
    const bool isCurveFirst = lut.is1D() || hasShaper;
    boost::optional<Range>& first = isCurveFirst ? curveRange_ : latticeRange_;
    if (domainMin_ || domainMax_) {
        const Range unit = unitRange();
        const Range stated{domainMin_.value_or(unit.min), domainMax_.value_or(unit.max)};
        if (first && !(first->min == stated.min && first->max == stated.max)) {
            const char* const keyword = isCurveFirst ? "LUT_1D_INPUT_RANGE" : "LUT_3D_INPUT_RANGE";
            remarkAt(0, "range", quoted(keyword) + " is not used: the domain is stated as well");
        }
        first = stated;
    }
    if (curveRange_ && curveSize_ == 0) {
        remarkAt(0, "range", "\"LUT_1D_INPUT_RANGE\" is not used: the file has no 1D block");
    }
    if (latticeRange_ && latticeSize_ == 0) {
        remarkAt(0, "range", "\"LUT_3D_INPUT_RANGE\" is not used: the file has no 3D block");
    }
    const boost::optional<Range>& domain = lut.is1D() ? curveRange_ : latticeRange_;
    if (domain) {
        expectRising(*domain);
        const int size = lut.width();
        setDomain(lut, *domain, {size, size, size});
    }
    if (!hasShaper) return;
    if (curveRange_ && !isUnit(*curveRange_)) {
        expectRising(*curveRange_);
        lut.inputShaper.entries = {curveRange_->min, curveRange_->max};
        lut.inputShaper.counts.fill(2.0F);
    }
    lut.outputShaper.counts.fill(static_cast<float>(shaper_.size()));
    shaper_.moveTo(lut.outputShaper);
}

void CubeInterchange::watch(std::string_view line) {
    const Tokens words(line);
    const std::string_view keyword = words[0];
    if (keyword == "LUT_1D_INPUT_RANGE" || keyword == "LUT_3D_INPUT_RANGE") {
        // Three words, as a sample has.
        remark("range", quoted(keyword) + " is taken for a sample");
    }
    const bool isMin = keyword == "DOMAIN_MIN";
    if (!isMin && keyword != "DOMAIN_MAX") return;
    const float usual = isMin ? 0.0F : 1.0F;
    for (std::size_t i = 1; i <= 3; ++i) {
        if (toFloat(words[i]) == usual) continue;
        remark("domain", "the domain is not used: the table covers 0 to 1");
        return;
    }
}

std::string CubeInterchange::reasonOf(std::string_view message, std::string_view lastLine) {
    const Tokens words(lastLine);
    if (message == kSizeError) return quoted(words[1]) + " is no size";
    if (message == kNoTable && isAtEnd()) {
        return "there is no line LUT_1D_SIZE or LUT_3D_SIZE";
    }
    return "";
}

}  // namespace Orlith::LUT
