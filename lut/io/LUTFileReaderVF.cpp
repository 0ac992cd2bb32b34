// Vector field (.vf; gzip-compressed: .vfz, .gz): Open Inventor text, blue fastest.
//
//   #Inventor V2.1 ascii
//   SoVectorField {                 not checked
//   parameters
//   grid_size 2 3 4                 points along red, green and blue
//   element_size 0.5 0.5 0.5        distance of the points in input space, and
//   world_origin 0.1 0.2 0.3          input of the first; or, winning over both,
//   global_transform m0 ... m15       from index to input: 4 x 4 by rows, translation in the last
//   data
//   0.0 0.1 0.2                     sample (0, 0, 0)
//   0.0 0.1 0.3                     sample (0, 0, 1)
//   ...
//   }                               not read, nor what follows

#include "lut/io/LUTFileReaderVF.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <fstream>

#include "lut/Exception.h"
#include "lut/LUT3D.h"
#include "lut/io/Lattice.h"
#include "lut/io/interchange/VFInterchange.h"
#include "lut/io/text/LineSource.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"
#include "lut/io/zlib_stream/zip_istream.h"

namespace Orlith::LUT {
namespace {

constexpr int kWindowSize = 15;
constexpr unsigned kBufferSize = 4096;

/// Where the parameters put the grid.
struct Placement {
    Transform grid;  // of element_size and world_origin
    Transform global;

    Placement() {
        grid.set_identity();
        global.set_identity();
    }

    const Transform& transform() const { return global.is_identity() ? grid : global; }
};

/// Empty at the end of the text.
std::string_view nextLine(LineSource& lines) {
    std::string_view line;
    lines.next(line);
    return line;
}

void expectHeader(LineSource& lines) {
    if (trim(nextLine(lines)) != "#Inventor V2.1 ascii") {
        throw Exception("VF file reader: expecting #Inventor V2.1 ascii header line.");
    }
}

void expectValues(const Tokens& words, std::size_t valueCount, const char* message) {
    if (words.count() != 1 + valueCount) throw Exception(message);
}

void readParameter(const Tokens& words, LUT3D& lut, Placement& placement) {
    if (words[0] == "grid_size") {
        expectValues(words, 3, "VF file reader: expecting 3 values for grid_size.");
        lut.resize(toInt(words[1]), toInt(words[2]), toInt(words[3]));
    } else if (words[0] == "element_size") {
        expectValues(words, 3, "VF file reader: expecting 3 values for element_size.");
        // Entered one by one: as a product of a scale and a translation, an infinite size or
        // origin times zero would put NaN into elements that are zero.
        for (unsigned c = 0; c < 3; ++c)
            placement.grid[c][c] = toFloat(words[1 + c]);
    } else if (words[0] == "world_origin") {
        expectValues(words, 3, "VF file reader: expecting 3 values for world_origin.");
        for (unsigned c = 0; c < 3; ++c)
            placement.grid[3][c] = toFloat(words[1 + c]);
    } else if (words[0] == "global_transform") {
        expectValues(words, 16, "VF file reader: expecting 16 more tokens.");
        for (unsigned i = 0; i < 16; ++i)
            placement.global[i / 4][i % 4] = toFloat(words[1 + i]);
    }
}

/// Reads up to and including the line "data". A file that does without "parameters" loses the line
/// in its place and has no parameters.
Placement readParameters(LineSource& lines, LUT3D& lut) {
    Placement placement;
    if (trim(nextLine(lines)) != "parameters") return placement;
    std::string_view line;
    Tokens words;
    while (lines.next(line)) {
        line = trim(line);
        if (line == "data") break;
        words.split(line);
        readParameter(words, lut, placement);
    }
    return placement;
}

void readSamples(LineSource& lines, LUT3D& lut, std::uint64_t& sampleCount) {
    const std::size_t pointCount = LatticeSize::of(lut).pointCount();
    float* sample = lut.data();
    Tokens words;
    RGB rgb;
    for (; sampleCount < pointCount; ++sampleCount) {
        const std::string_view line = nextLine(lines);
        if (!lines.parseTriple(line, rgb)) {
            words.split(line);
            if (words.count() != 3) {
                throw Exception("VF file reader: syntax error while reading LUT data.");
            }
            rgb = RGB(toFloat(words[0]), toFloat(words[1]), toFloat(words[2]));
        }
        sample = std::copy_n(rgb.data_block(), 3, sample);
    }
    placeBlueFastest(lut, pointCount);
}

}  // namespace

boost::shared_ptr<LUT> LUTFileReaderVF::read(const std::string& filename) {
    beginRead();
    std::ifstream file(filename);
    if (!file) failToOpen("VF file reader: unable to open file.");
    zlib_stream::zip_istream unzipped(file, kWindowSize, kBufferSize, kBufferSize);
    std::istream& text = unzipped.isGzip() ? static_cast<std::istream&>(unzipped) : file;
    VFInterchange meant(reading());
    LineSource lines(text, lineNumber_, &meant);
    return meant.explainFailures([&] {
        const auto lut = boost::make_shared<LUT3D>();
        expectHeader(lines);
        nextLine(lines);  // "SoVectorField {"
        const Placement placement = readParameters(lines, *lut);
        readSamples(lines, *lut, sampleCount_);
        lut->transform = placement.transform();
        meant.finish(*lut, lines);
        lut_ = lut;
        return lut_;
    });
}

}  // namespace Orlith::LUT
