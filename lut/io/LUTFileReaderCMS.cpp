// Nucoda (.cms): text, red fastest.
//
//   NUCODA_3D_CUBE 1        ignored
//   TITLE "anything"        ignored
//   # comment               the mark has to stand alone; not within the pre-LUT
//   LUT_1D_SIZE 3           entries of the pre-LUT
//   LUT_3D_SIZE 2           points along each axis
//   0.0 0.0 0.0             pre-LUT, entry 0: in units of points, 0 to N
//   ...
//   0.0 0.0 0.0             sample (0, 0, 0)
//   1.0 0.0 0.0             sample (1, 0, 0)
//   ...
//
// Lines are trimmed, empty ones skipped. Surplus samples start over from the first point, missing
// ones stay zero. A second lattice size starts a new table, without a pre-LUT; the place of the
// next sample stays where it was.

#include "lut/io/LUTFileReaderCMS.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <fstream>

#include "lut/Exception.h"
#include "lut/LUT3D.h"
#include "lut/io/Lattice.h"
#include "lut/io/ShaperEntries.h"
#include "lut/io/interchange/CMSInterchange.h"
#include "lut/io/text/LineSource.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kDataError[] = "CMS LUT reader: syntax error while reading LUT data.";
constexpr char kPreLUTError[] = "CMS LUT reader: syntax error while reading pre-LUT data.";

/// A line that is not empty.
class Line {
public:
    /// @return false at the end of the file
    bool next(LineSource& lines) {
        std::string_view text;
        while (lines.next(text)) {
            isPlain_ = lines.parseTriple(text, rgb_);
            if (isPlain_) return true;
            tokens_.split(trim(text));
            if (!tokens_.empty()) return true;
        }
        return false;
    }

    /// Word i of a line that may be no data; empty if it is data at first sight.
    std::string_view word(std::size_t i) const {
        return isPlain_ ? std::string_view() : tokens_[i];
    }

    RGB expectTriple(const char* error) const {
        if (isPlain_) return rgb_;
        if (tokens_.count() != 3) throw Exception(error);
        return {toFloat(tokens_[0]), toFloat(tokens_[1]), toFloat(tokens_[2])};
    }

private:
    bool isPlain_ = false;  // three plain numbers, in rgb_; else the words are in tokens_
    RGB rgb_;
    Tokens tokens_;
};

/// What the size lines said last.
struct Sizes {
    int lattice = 0;
    int preLUT = 0;

    /// A scale of 1 / (N - 1) needs two points.
    bool hasTable() const { return lattice >= 2; }
};

/// Looks for the next line of data; size lines on the way take effect.
/// @param lut  replaced at a lattice size
/// @return false at the end of the file, or at data that has no table to go to
bool findData(LineSource& lines, Line& line, Sizes& sizes, boost::shared_ptr<LUT>& lut) {
    while (line.next(lines)) {
        const std::string_view keyword = line.word(0);
        if (keyword == "#" || keyword == "TITLE" || keyword == "NUCODA_3D_CUBE") continue;
        if (keyword == "LUT_3D_SIZE") {
            lut = boost::make_shared<LUT3D>();
            sizes.lattice = toInt(line.word(1));
            lut->resize(sizes.lattice);
        } else if (keyword == "LUT_1D_SIZE") {
            sizes.preLUT = toInt(line.word(1));
        } else {
            return sizes.hasTable();
        }
    }
    return false;
}

/// Reads the pre-LUT, whose first line is in hand.
void readPreLUT(LineSource& lines, Line& line, int entryCount, Shaper& shaper) {
    if (entryCount <= 0) throw Exception(kPreLUTError);
    // The count is a claim: entries are made as they arrive.
    ShaperEntries entries;
    entries.push_back(line.expectTriple(kPreLUTError));
    for (int entry = 1; entry < entryCount; ++entry) {
        if (!line.next(lines)) throw Exception("CMS LUT reader: expecting more pre-LUT data.");
        // Deliberate: the message of the lattice from the second entry on, for comments as well;
        // callers may know it. Held by tests/data/read/cms.txt.
        entries.push_back(line.expectTriple(kDataError));
    }
    entries.moveTo(shaper);
    const auto count = static_cast<float>(entryCount);
    shaper.counts = RGB(count, count, count);
}

void storeSample(LUT& lut, int size, LatticePosition& point, const RGB& rgb) {
    const LatticeSize lattice{size, size, size};
    // A second, smaller lattice may have come since the last sample.
    if (!point.isInside(lattice)) throw Exception(kDataError);
    std::copy_n(rgb.data_block(), 3, lut.data() + 3 * point.element(lattice));
    point.advanceRedFastest(lattice);
}

/// Deliberate: by N, not by N - 1, and on reading only, so that a file keeps its meaning; writing
/// a table and reading it back divides its pre-LUT. Held by tests/data/read/cms.txt.
void scalePreLUT(Shaper& shaper, int size) {
    for (RGB& entry : shaper.entries) {
        for (unsigned c = 0; c < 3; ++c)
            entry[c] /= static_cast<float>(size);
    }
}

}  // namespace

boost::shared_ptr<LUT> LUTFileReaderCMS::read(const std::string& filename) {
    beginRead();
    std::ifstream file(filename);
    if (!file) failToOpen("CMS LUT reader: unable to open file.");
    CMSInterchange meant(reading());
    LineSource lines(file, lineNumber_, &meant);
    return meant.explainFailures([&] {
        readTable(lines, meant);
        meant.finish(*lut_, lines);
        return lut_;
    });
}

void LUTFileReaderCMS::readTable(LineSource& lines, const CMSInterchange& meant) {
    Line line;
    Sizes sizes;
    bool isData = findData(lines, line, sizes, lut_);
    if (isData && meant.hasPreLUT()) {
        readPreLUT(lines, line, sizes.preLUT, lut_->outputShaper);
        isData = findData(lines, line, sizes, lut_);
    }
    for (LatticePosition point; isData; isData = findData(lines, line, sizes, lut_)) {
        storeSample(*lut_, sizes.lattice, point, line.expectTriple(kDataError));
        ++sampleCount_;
    }
    if (!sizes.hasTable()) throw Exception("CMS LUT reader: failed to read LUT file.");
    scalePreLUT(lut_->outputShaper, sizes.lattice);
    setUnitDomain(*lut_, sizes.lattice, sizes.lattice, sizes.lattice);
}

}  // namespace Orlith::LUT
