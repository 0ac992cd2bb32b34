// Truelight cube (.cub): text, red fastest.
//
//   # Truelight Cube v2.0   a mark that stands alone starts a keyword line; unknown ones, as these
//   # iDims 3               first three, are ignored
//   # oDims 3
//   # width 2 3 4           points along red, green, blue
//   # lutLength 5           optional: entries of the input LUT
//   # InputLUT              what follows is input LUT:
//   0.0 0.0 0.0               the lattice position of an input colour, for each channel
//   ...
//   # Cube                  what follows is cube, as it is from the start of the file:
//   0.0 0.1 0.2               sample (0, 0, 0)
//   1.0 0.1 0.2               sample (1, 0, 0)
//   ...
//   # end                   optional; nothing after it is read
//
// Keywords are known in upper and lower case. Lines are split into words before anything is
// trimmed. Surplus samples start over from the first point, missing ones stay zero; no count is
// checked.

#include "lut/io/LUTFileReaderTruelight.h"

#include <algorithm>
#include <boost/algorithm/string/predicate.hpp>
#include <boost/smart_ptr/make_shared.hpp>
#include <fstream>
#include <locale>
#include <stdexcept>

#include "lut/Exception.h"
#include "lut/LUT3D.h"
#include "lut/io/Lattice.h"
#include "lut/io/ShaperEntries.h"
#include "lut/io/interchange/TruelightInterchange.h"
#include "lut/io/text/LineSource.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kCubeError[] =
    "Truelight LUT reader: syntax error while reading LUT data (too many or not enough values).";
constexpr char kInputLUTError[] =
    "Truelight LUT reader: syntax error while reading pre-LUT data (too many or not enough "
    "values).";

/// The cube, and where its next sample goes. A second width line resizes the table: samples keep
/// their place in storage, and the position stays.
class Cube {
public:
    explicit Cube(LUT3D& lut) : lut_(lut) {}

    void resize(const LatticeSize& size) {
        lut_.resize(size.width, size.height, size.depth);
        size_ = size;
        samples_ = lut_.data();
    }

    void add(const RGB& rgb) {
        if (!next_.isInside(size_)) throw Exception(kCubeError);
        std::copy_n(rgb.data_block(), 3, samples_ + 3 * next_.element(size_));
        next_.advanceRedFastest(size_);
    }

private:
    LUT3D& lut_;
    LatticeSize size_;
    LatticePosition next_;
    float* samples_ = nullptr;
};

enum class Data { InputLUT, Cube };

void readWidth(const Tokens& tokens, Cube& cube) {
    if (tokens.count() != 5) throw Exception("Truelight LUT reader: expected 3 values for width.");
    cube.resize({toInt(tokens[2]), toInt(tokens[3]), toInt(tokens[4])});
}

void readInputLUTLength(const Tokens& tokens, Shaper& inputLUT) {
    if (tokens.count() < 3) return;
    const int entryCount = toInt(tokens[2]);
    if (entryCount < 0) throw std::length_error("Truelight LUT reader: negative lutLength");
    // Only the count is believed: the entries grow as they are read.
    inputLUT.counts.fill(static_cast<float>(entryCount));
}

/// A keyword line: "#", keyword, values.
/// @return false if nothing more is to be read
bool readKeyword(const Tokens& tokens, LUT& lut, Cube& cube, Data& data) {
    // Deliberate: lines are not trimmed, so a carriage return is part of the keyword that it
    // follows, which is then unknown. Held by tests/data/read/cub.txt.
    const auto isKeyword = [&](const char* keyword) {
        return boost::algorithm::iequals(tokens[1], keyword, std::locale::classic());
    };
    if (isKeyword("width")) readWidth(tokens, cube);
    if (isKeyword("lutlength")) readInputLUTLength(tokens, lut.outputShaper);
    if (isKeyword("inputlut")) data = Data::InputLUT;
    if (isKeyword("cube")) data = Data::Cube;
    return !isKeyword("end");
}

/// A data line that is no plain triple: three words, of which trimming leaves three.
/// @return false if trimming leaves nothing, as of a cube line of form feeds: it is skipped
bool readData(std::string_view line, Tokens& tokens, Data data, RGB& rgb) {
    if (tokens.count() != 3) {
        throw Exception(data == Data::Cube ? kCubeError
                                           : "Truelight LUT reader: expecting more pre-LUT data.");
    }
    tokens.split(trim(line));
    if (data == Data::Cube && tokens.empty()) return false;
    if (tokens.count() != 3) throw Exception(data == Data::Cube ? kCubeError : kInputLUTError);
    rgb = RGB(toFloat(tokens[0]), toFloat(tokens[1]), toFloat(tokens[2]));
    return true;
}

}  // namespace

boost::shared_ptr<LUT> LUTFileReaderTruelight::read(const std::string& filename) {
    beginRead();
    std::ifstream file(filename);
    if (!file) failToOpen("Truelight LUT reader: unable to open file.");
    TruelightInterchange meant(reading());
    LineSource lines(file, lineNumber_, &meant);
    return meant.explainFailures([&] {
        auto lut = readTable(lines);
        meant.finish(*lut, lines);
        return lut;
    });
}

boost::shared_ptr<LUT> LUTFileReaderTruelight::readTable(LineSource& lines) {
    const auto lut = boost::make_shared<LUT3D>();
    lut_ = lut;
    Cube cube(*lut);
    ShaperEntries inputLUT;
    Data data = Data::Cube;
    std::string_view line;
    Tokens tokens;
    RGB rgb;
    while (lines.next(line)) {
        if (!lines.parseTriple(line, rgb)) {
            tokens.split(line);
            if (tokens.empty()) continue;
            if (tokens[0] == "#") {
                if (!readKeyword(tokens, *lut, cube, data)) break;
                continue;
            }
            if (!readData(line, tokens, data, rgb)) continue;
        }
        if (data == Data::InputLUT) {
            inputLUT.push_back(rgb);
        } else {
            cube.add(rgb);
            ++sampleCount_;
        }
    }
    if (inputLUT.empty() && sampleCount_ == 0) {
        throw Exception("Truelight LUT reader: syntax error while reading LUT data.");
    }
    // An input LUT leads from inputs to lattice positions by itself: identity.
    if (inputLUT.empty()) setUnitDomain(*lut, lut->width(), lut->height(), lut->depth());
    inputLUT.moveTo(lut->outputShaper);
    return lut;
}

}  // namespace Orlith::LUT
