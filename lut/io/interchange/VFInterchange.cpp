#include "lut/io/interchange/VFInterchange.h"

#include <cmath>

#include "lut/io/Lattice.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kDataError[] = "VF file reader: syntax error while reading LUT data.";
constexpr char kHeaderError[] = "VF file reader: expecting #Inventor V2.1 ascii header line.";
constexpr char kGridError[] = "VF file reader: expecting 3 values for grid_size.";

/// Whether the points stand in steps of 1/N from 0 on, as far as six digits behind the point say.
bool isInStepsOfOneOverN(const LUT& lut) {
    constexpr float kHalfADigit = 0.51e-6F;
    const int points[] = {lut.width(), lut.height(), lut.depth()};
    for (unsigned c = 0; c < 3; ++c) {
        const float step = 1.0F / static_cast<float>(points[c]);
        if (lut.transform[3][c] != 0.0F) return false;
        if (std::fabs(lut.transform[c][c] - step) > kHalfADigit) return false;
    }
    return true;
}

/// Whether the channels depend on each other.
bool isTurned(const Transform& transform) {
    for (unsigned row = 0; row < 3; ++row) {
        for (unsigned column = 0; column < 3; ++column) {
            if (row != column && transform[row][column] != 0.0F) return true;
        }
    }
    return false;
}

std::uint64_t toSide(std::string_view word) {
    const int side = toInt(word);
    return side > 0 ? static_cast<std::uint64_t>(side) : 0;
}

}  // namespace

const char* VFInterchange::dataError() const {
    return kDataError;
}

bool VFInterchange::isVerbatim(std::string_view line) {
    if (hasHeader_ || line.empty()) return false;
    hasHeader_ = true;
    return true;
}

bool VFInterchange::takeKeyword(std::string_view line) {
    // The first stands for the node, and the book does not look at it.
    ++keywordCount_;
    if (keywordCount_ == 1) return true;
    if (keywordCount_ == 2 && line != "parameters") {
        fail(kDataError, quoted(line) + " stands where \"parameters\" should");
    }
    if (keywordCount_ == 2) return true;
    if (!hasData_) return takeParameter(line);
    remarkUnknown(line);
    return false;
}

bool VFInterchange::takeParameter(std::string_view line) {
    const Tokens words(line);
    const std::string_view keyword = words[0];
    if (keyword == "data") {
        if (points_ == 0) fail(kDataError, "there is no line grid_size");
        hasData_ = true;
    } else if (keyword == "grid_size") {
        if (points_ != 0) fail(kGridError, "a second line grid_size");
        expectNumbersBehind(line, 3);
        for (std::size_t i = 1; i <= 3; ++i)
            expectSize(words[i], kGridError);
        watch(line);
    } else if (keyword == "element_size" || keyword == "world_origin") {
        expectNumbersBehind(line, 3);
        hasPlacement_ = true;
    } else if (keyword == "global_transform") {
        expectNumbersBehind(line, 16);
        hasPlacement_ = true;
    } else {
        remarkUnknown(line);
        return false;
    }
    return true;
}

void VFInterchange::finish(LUT& lut, LineSource& lines) {
    if (isMeant() && points_ == 0) fail(kDataError, "there is no line grid_size");
    expectAllSamples(lut, lines);
    if (isTurned(lut.transform)) {
        remarkAt(0, "turned", "what global_transform turns or shears is not used");
    }
    if (!isMeant()) return;
    const LatticeSize size = LatticeSize::of(lut);
    if (!hasPlacement_) {
        remarkAt(0, "placement",
                 "the file does not place its grid, which is taken to cover 0 to 1");
    }
    if (!hasPlacement_ || isInStepsOfOneOverN(lut)) {
        setUnitDomain(lut, size.width, size.height, size.depth);
        return;
    }
    expectRising(domainOf(lut));
}

void VFInterchange::watch(std::string_view line) {
    const Tokens words(line);
    if (words[0] == "grid_size") points_ = toSide(words[1]) * toSide(words[2]) * toSide(words[3]);
}

std::string VFInterchange::reasonOf(std::string_view message, std::string_view lastLine) {
    if (message == kHeaderError) {
        return lastLine.empty() ? "the file is empty" : "the file begins with " + quoted(lastLine);
    }
    return isAtEnd() ? endReason(points_) : "";
}

}  // namespace Orlith::LUT
