#include "lut/io/interchange/ThreeDLInterchange.h"

#include <algorithm>
#include <cmath>

#include "lut/FloatToInt.h"
#include "lut/io/Dialect3DL.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kDataError[] = "3DL file reader: syntax error while reading LUT data";
constexpr char kNoGrid[] = "3DL file reader: syntax error while reading LUT size";
constexpr char kNotFull[] = "3DL file reader: integer LUT input must be full range (0-1)";
constexpr char kNotLinear[] = "3DL file reader: LUT input values must be linear";
constexpr char kWrongSize[] = "3DL file reader: input data size does not match cube dimensions";
constexpr char kNoDialect[] = "3DL file reader: invalid 3DL format specified for reading";

constexpr int kFewestPoints = 2;     // one point has no slope
constexpr int kUsualInputBits = 10;  // of grids

bool isLineOf3DMesh(std::string_view line) {
    return line.substr(0, 6) == "3DMESH";
}

/// A line of numbers as an input grid.
class GridLine {
public:
    explicit GridLine(std::string_view line)
        : line_(line), isCodes_(line.find('.') == std::string_view::npos) {
        bool isFirst = true;
        forEachWord([&](std::string_view word) {
            const float number = toFloat(word);
            if (isFirst) first_ = number;
            if (!isFirst && !(number > last_)) rises_ = false;
            if (!isFirst && !(number >= last_)) falls_ = true;
            isFirst = false;
            last_ = number;
            const std::size_t point = word.find('.');
            if (point != std::string_view::npos)
                digits_ = std::max(digits_, word.size() - point - 1);
            ++count_;
        });
    }

    std::size_t count() const { return count_; }
    float first() const { return first_; }
    float last() const { return last_; }
    bool rises() const { return rises_; }

    /// Codes of few bits repeat where there are more points: 0 1 2 2 3.
    bool isEvenInFewBits() const { return isCodes_ && !falls_ && last_ > first_ && isEven(); }

    /// Codes, or numbers with a point.
    bool isCodes() const { return isCodes_; }

    /// Programs round or cut off, and end at 1023 what goes in steps of 64: no number is off by
    /// more than one unit of its last digit.
    bool isEven() const {
        const double unit = std::pow(0.1, static_cast<double>(digits_));
        const double step = (static_cast<double>(last_) - static_cast<double>(first_)) /
                            static_cast<double>(count_ - 1);
        double even = static_cast<double>(first_);
        std::size_t i = 0;
        bool isEven = true;
        forEachWord([&](std::string_view word) {
            even = static_cast<double>(first_) + static_cast<double>(i++) * step;
            const double off = std::fabs(static_cast<double>(toFloat(word)) - even);
            // Some slack for single precision.
            if (!(off <= unit * 1.001)) isEven = false;
        });
        return isEven;
    }

    std::vector<float> numbers() const {
        std::vector<float> numbers;
        numbers.reserve(count_);
        forEachWord([&](std::string_view word) { numbers.push_back(toFloat(word)); });
        return numbers;
    }

private:
    template <class Visit>
    void forEachWord(Visit visit) const {
        std::string_view word;
        for (std::string_view rest = line_; takeWord(rest, word);)
            visit(word);
    }

    std::string_view line_;
    bool isCodes_;
    bool rises_ = true;
    bool falls_ = false;  // somewhere
    float first_ = 0.0F;
    float last_ = 0.0F;
    std::size_t count_ = 0;
    std::size_t digits_ = 0;  // behind the point, at most
};

/// Bits of a grid's last code, which may be the first code too many: 10 for 1023 and for 1024.
int inputBitsOf(float last) {
    return std::max(1, bitCountOf(toInt32(std::nearbyint(last)) - 1));
}

constexpr std::size_t kHeldBlock = 131072;  // samples, in pages of their own

}  // namespace

void HeldSamples::add(const RGB& sample) {
    if (added_ % kHeldBlock == 0) blocks_.emplace_back().resize(kHeldBlock);
    blocks_.back()[added_++ % kHeldBlock] = sample;
}

bool HeldSamples::take(RGB& sample) {
    if (taken_ == added_) return false;
    sample = blocks_.front()[taken_++ % kHeldBlock];
    if (taken_ % kHeldBlock == 0) blocks_.pop_front();
    return true;
}

const char* ThreeDLInterchange::dataError() const {
    return kDataError;
}

/// It begins with a digit and is no number.
bool ThreeDLInterchange::isVerbatim(std::string_view line) {
    return !isBelowHeader_ && isLineOf3DMesh(line);
}

bool ThreeDLInterchange::takeComment(std::string_view line) {
    if (isBelowHeader_) return false;
    expectOwnFormat(line);
    return true;
}

bool ThreeDLInterchange::passesOver(std::string_view line) {
    if (!isMeant()) return false;
    // What else begins a number was seen to be one.
    const bool isWord = isLineOf3DMesh(line) ||
                        std::string_view("+-.0123456789").find(line[0]) == std::string_view::npos;
    if (isWord) remarkUnknown(line);
    return isWord;
}

void ThreeDLInterchange::watchGrid(std::string_view line, const Header3DL& header) {
    const GridLine grid(line);
    const Tokens words(line);
    gridSize_ = grid.count();
    gridEnds_ = quoted(words[0]) + " to " + quoted(line.substr(line.find_last_of(" \t") + 1));
    statedSize_ = header.pointsPerSide();
    if (!isMeant() && grid.rises() && grid.count() > 1 && !grid.isEven()) {
        remark("grid", "the input grid is not evenly spaced and is taken as if it were");
    }
}

Grid3DL ThreeDLInterchange::findGrid(std::string_view line, const Header3DL& header,
                                     LineSource& lines) {
    isBelowHeader_ = true;
    if (countWords(line) != 3) return gridOf(line, header);

    // Three numbers are a sample, or a grid of three points: of 28 lines the first is a grid.
    constexpr std::size_t kGridAndSamples = 28;
    const std::string first(line);
    const std::uint64_t firstLine = lineNumber();
    const int statedSize = header.pointsPerSide();
    int pointCount = statedSize;
    hold(line, lines);
    if (statedSize <= 0 || statedSize == 3) {
        while (lines.next(line))
            hold(line, lines);
        if (held_.size() == kGridAndSamples) {
            RGB grid;
            held_.take(grid);
            return gridOf(first, header);
        }
        pointCount = countPoints();
    }
    if (pointCount < kFewestPoints) fail(kNoGrid, "a table needs at least 2 points a side");
    gridSize_ = static_cast<std::size_t>(pointCount);
    remarkAt(firstLine, "grid",
             "there is no input grid: the points are taken for even steps from 0 to 1");
    const bool isCodes = GridLine(first).isCodes() && header.inputBits() == 0;
    return {pointCount, 0.0F, 1.0F, isCodes ? kUsualInputBits : header.inputBits()};
}

/// The cube root of the number of samples.
int ThreeDLInterchange::countPoints() {
    const std::size_t count = held_.size();
    const auto side = static_cast<std::size_t>(std::lround(std::cbrt(static_cast<double>(count))));
    if (side * side * side != count) {
        fail(kDataError, "there is no input grid of more than three points, and the " +
                             std::to_string(count) +
                             " lines are neither a grid of three and its 27 samples nor the "
                             "samples of a cube");
    }
    return static_cast<int>(side);
}

void ThreeDLInterchange::hold(std::string_view line, const LineSource& lines) {
    RGB rgb;
    if (!lines.parseTriple(line, rgb)) {
        const Tokens words(line);
        if (words.count() != 3) throw Exception(kDataError);
        rgb = RGB(toFloat(words[0]), toFloat(words[1]), toFloat(words[2]));
    }
    held_.add(rgb);
}

Grid3DL ThreeDLInterchange::gridOf(std::string_view line, const Header3DL& header) {
    const GridLine grid(line);
    if (grid.count() < kFewestPoints) fail(kNoGrid, "an input grid needs at least 2 points");
    if (!grid.rises() && !grid.isEvenInFewBits()) fail(kNotLinear, "the input grid does not rise");
    const auto pointCount = static_cast<int>(grid.count());  // a line holds fewer words
    const bool isEven = grid.isEven();
    if (!isEven) shaper_ = grid.numbers();
    if (!grid.isCodes()) {
        const float origin = isEven ? grid.first() : 0.0F;
        const float range = isEven ? grid.last() - grid.first() : 1.0F;
        return {pointCount, origin, range, header.inputBits()};
    }
    for (float& code : shaper_)
        code = (code - grid.first()) / (grid.last() - grid.first());
    const int last = toInt32(std::nearbyint(grid.last()));
    if (grid.first() != 0.0F || !(isCodeMax(last) || isCodeMax(last - 1))) {
        remark("range",
               "the input grid does not fill its bits: its first code is taken for 0 and "
               "its last one for 1");
    }
    return {pointCount, 0.0F, 1.0F, inputBitsOf(grid.last())};
}

void ThreeDLInterchange::finish(LUT& lut, LineSource& lines) {
    expectAllSamples(lut, lines);
    if (shaper_.empty()) return;
    for (const float position : shaper_)
        lut.inputShaper.entries.emplace_back(position, position, position);
    lut.inputShaper.counts.fill(static_cast<float>(shaper_.size()));
}

std::string ThreeDLInterchange::reasonOf(std::string_view message, std::string_view) {
    if (message == kNoDialect) {
        return "the property format3DL is none of auto, flame, lustre and scratch";
    }
    if (message.find("unable to find") != std::string_view::npos) {
        return "a property that the reader needs is not set";
    }
    if (message == kNoGrid) return "there is no input grid";
    const bool isGridError = message == kNotFull || message == kNotLinear;
    if (isGridError && gridSize_ == 3) return "there is no input grid above these three numbers";
    if (message == kNotFull) return "the input grid runs from " + gridEnds_;
    if (message == kNotLinear) return "the input grid is not evenly spaced";
    if (message == kWrongSize) {
        if (statedSize_ < 0) return "the Mesh line states a size that no table can have";
        return "the file states " + std::to_string(statedSize_) + " points a side and has " +
               std::to_string(gridSize_);
    }
    return "";
}

}  // namespace Orlith::LUT
