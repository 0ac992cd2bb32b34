#include "lut/io/interchange/CMSInterchange.h"

#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kDataError[] = "CMS LUT reader: syntax error while reading LUT data.";
constexpr char kPreLUTError[] = "CMS LUT reader: syntax error while reading pre-LUT data.";
constexpr char kPreLUTEnds[] = "CMS LUT reader: expecting more pre-LUT data.";
constexpr char kNoTable[] = "CMS LUT reader: failed to read LUT file.";

}  // namespace

const char* CMSInterchange::dataError() const {
    return kDataError;
}

bool CMSInterchange::takeKeyword(std::string_view line) {
    const Tokens words(line);
    const std::string_view keyword = words[0];
    if (keyword == "TITLE" || keyword == "NUCODA_3D_CUBE") return false;
    if (keyword == "LUT_1D_SIZE" || keyword == "LUT_3D_SIZE") {
        int& size = keyword == "LUT_1D_SIZE" ? preLUTSize_ : latticeSize_;
        if (size != 0) fail(kDataError, "a second size line");
        if (sampleCount() > 0) fail(kDataError, "a size line behind samples");
        size = expectSize(words[1], kDataError);
        return true;
    }
    if (keyword == "LUT_3D_INPUT_RANGE") {
        range_ = expectRangeBehind(line);
    } else {
        remarkUnknown(line);
    }
    return false;
}

void CMSInterchange::finish(LUT& lut, LineSource& lines) {
    expectAllSamples(lut, lines);
    if (!range_) return;
    if (hasPreLUT()) {
        if (!isUnit(*range_)) {
            remarkAt(0, "range",
                     "the range is not used: the pre-LUT leads to the lattice by itself");
        }
        return;
    }
    setDomain(lut, *range_, {latticeSize_, latticeSize_, latticeSize_});
}

void CMSInterchange::watch(std::string_view line) {
    const Tokens words(line);
    const std::string_view keyword = words[0];
    if (keyword == "LUT_1D_SIZE") preLUTSize_ = toInt(words[1]);
    if (keyword == "LUT_3D_SIZE") latticeSize_ = toInt(words[1]);
    if (keyword == "LUT_3D_INPUT_RANGE" || keyword == "LUT_1D_INPUT_RANGE") {
        // Three words, as a sample has.
        remark("range", quoted(keyword) + " is taken for an entry or a sample");
    }
}

std::string CMSInterchange::reasonOf(std::string_view message, std::string_view) {
    if (message == kNoTable) {
        if (latticeSize_ != 0) return "a table needs at least 2 points a side";
        return isAtEnd() ? "there is no line LUT_3D_SIZE"
                         : "the line LUT_3D_SIZE has to come before this one";
    }
    if (message == kPreLUTError && preLUTSize_ <= 0) return "there is no line LUT_1D_SIZE";
    if (message == kPreLUTEnds) {
        return "the file ends within the " + std::to_string(preLUTSize_) +
               " entries of the pre-LUT";
    }
    return "";
}

}  // namespace Orlith::LUT
