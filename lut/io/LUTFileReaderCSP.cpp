// cineSpace (.csp): text, one item a line, red fastest.
//
//   CSPLUTV100
//   3D                      or 1D
//   BEGIN METADATA          optional; skipped up to END METADATA
//   2                       red shaper: number of points,
//   0.0 1.0                   input positions,
//   0.0 1.0                   output values; then green, then blue
//   2 2 2                   points along red, green, blue (1D: one count)
//   0.0 0.0 0.0             sample (0, 0, 0)
//   1.0 0.0 0.0             sample (1, 0, 0)
//   ...
//
// Empty lines are skipped up to the size line, lines that start with # from the first shaper's
// input positions (after metadata: from its count) to the last one's output values.

#include "lut/io/LUTFileReaderCSP.h"

#include <algorithm>
#include <array>
#include <boost/smart_ptr/make_shared.hpp>
#include <fstream>
#include <vector>

#include "lut/Exception.h"
#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "lut/io/Lattice.h"
#include "lut/io/text/LineSource.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kNoMoreEntries[] =
    "CSP LUT reader: syntax error while reading LUT data, expecting more data.";

/// This format's lines: trimmed; one that ends in a backslash has the next physical line joined to
/// it behind a blank.
/// Deliberate: the backslash stays, as a word or the end of one, and a second one joins nothing.
/// Held by tests/data/read/csp.txt.
class ItemSource {
public:
    ItemSource(std::istream& text, std::uint64_t& lineNumber) : lines_(text, lineNumber) {}

    /// A line of the header or a shaper, good until the next call.
    /// @return false at the end of the file, line is then empty
    bool next(std::string_view& line) {
        if (!lines_.next(line) || !join(line)) return false;
        line = trim(line);
        return true;
    }

    /// A sample: the first three numbers of a line.
    /// Deliberate: missing ones are 0, so that an empty line is a sample, and whatever follows them
    /// is ignored. Held by tests/data/read/csp.txt.
    /// @return false at the end of the file
    bool nextSample(float* sample) {
        std::string_view line;
        if (!lines_.next(line)) return false;
        RGB rgb;
        if (!parsePlainTriple(line, rgb)) {
            if (!join(line)) return false;
            tokens_.split(line);
            rgb = RGB(toFloat(tokens_[0]), toFloat(tokens_[1]), toFloat(tokens_[2]));
        }
        std::copy_n(rgb.data_block(), 3, sample);
        return true;
    }

private:
    /// @return false if the file ends where the rest of the line should be, line is then empty
    bool join(std::string_view& line) {
        line = trim(line);
        if (line.empty() || line.back() != '\\') return true;
        joined_.assign(line).append(" ");
        if (!lines_.next(line)) return false;
        line = joined_.append(line);
        return true;
    }

    LineSource lines_;
    std::string joined_;
    Tokens tokens_;
};

/// The next line that is not empty; an empty one at the end of the file.
std::string_view nextFilled(ItemSource& items) {
    std::string_view line;
    while (items.next(line) && line.empty()) {
    }
    return line;
}

void expectVersion(ItemSource& items) {
    std::string_view line;
    items.next(line);
    if (line != "CSPLUTV100") {
        throw Exception("CSP LUT reader: expecting version identifier CSPLUTV100.");
    }
}

boost::shared_ptr<LUT> makeTable(ItemSource& items) {
    std::string_view line;
    items.next(line);
    if (line == "3D") return boost::make_shared<LUT3D>();
    if (line == "1D") return boost::make_shared<LUT1D>();
    throw Exception("CSP LUT reader: expecting a 1D or 3D lut.");
}

void skipMetadata(ItemSource& items) {
    std::string_view line;
    while (items.next(line) && line != "END METADATA") {
    }
}

std::string_view expectShaperLine(ItemSource& items) {
    std::string_view line;
    do {
        if (!items.next(line)) throw Exception("CSP LUT reader: expecting more pre-LUT data.");
    } while (line.empty() || line.front() == '#');
    return line;
}

/// One line of a shaper. It never comes back empty: a shaper line has a word, so that a count of
/// zero cannot agree with it.
std::vector<float> readRow(ItemSource& items, int pointCount) {
    const Tokens tokens(expectShaperLine(items));
    // The count is a claim: room is made only for the numbers that are there.
    if (static_cast<std::int64_t>(tokens.count()) != pointCount) {
        throw Exception(
            "CSP LUT reader: found different number of data elements than pre-LUT size specified.");
    }
    std::vector<float> row(tokens.count());
    for (std::size_t i = 0; i < row.size(); ++i)
        row[i] = toFloat(tokens[i]);
    return row;
}

/// Three rows side by side, the shorter ones continued with their last value.
Shaper merge(const std::array<std::vector<float>, 3>& rows) {
    Shaper shaper;
    shaper.entries.resize(std::max({rows[0].size(), rows[1].size(), rows[2].size()}));
    for (unsigned c = 0; c < 3; ++c) {
        const std::vector<float>& row = rows[c];
        shaper.counts[c] = static_cast<float>(row.size());
        for (std::size_t i = 0; i < shaper.entries.size(); ++i)
            shaper.entries[i][c] = i < row.size() ? row[i] : row.back();
    }
    return shaper;
}

void readShapers(ItemSource& items, LUT& lut) {
    // Deliberate: without metadata the line in hand is red's count, comment mark or not. Held by
    // tests/data/read/csp.txt.
    std::string_view countLine = nextFilled(items);
    if (countLine == "BEGIN METADATA") {
        skipMetadata(items);
        countLine = expectShaperLine(items);
    }
    std::array<std::vector<float>, 3> inputs;
    std::array<std::vector<float>, 3> outputs;
    for (unsigned c = 0; c < 3; ++c) {
        if (c > 0) countLine = expectShaperLine(items);
        const int pointCount = toInt(countLine);
        inputs[c] = readRow(items, pointCount);
        outputs[c] = readRow(items, pointCount);
    }
    lut.inputShaper = merge(inputs);
    lut.outputShaper = merge(outputs);
}

void readCurve(ItemSource& items, LUT& lut, std::uint64_t& sampleCount) {
    const std::string_view line = nextFilled(items);
    if (line.empty()) throw Exception(kNoMoreEntries);
    const int size = toInt(line);
    lut.resize(size);
    float* const samples = lut.data();
    for (std::size_t entry = 0; entry < static_cast<std::size_t>(size); ++entry) {
        if (!items.nextSample(samples + 3 * entry)) throw Exception(kNoMoreEntries);
        ++sampleCount;
    }
    setUnitDomain(lut, size, size, size);
}

void readLattice(ItemSource& items, LUT& lut, std::uint64_t& sampleCount) {
    const Tokens tokens(nextFilled(items));
    if (tokens.count() != 3) {
        throw Exception("CSP LUT reader: syntax error while reading 3D LUT size.");
    }
    const LatticeSize size{toInt(tokens[0]), toInt(tokens[1]), toInt(tokens[2])};
    lut.resize(size.width, size.height, size.depth);
    float* const samples = lut.data();
    forEachRedFastest(size, [&](std::size_t element) {
        if (!items.nextSample(samples + 3 * element)) {
            throw Exception(
                "CSP LUT reader: syntax error while reading 3D LUT data, expecting more data.");
        }
        ++sampleCount;
    });
    setUnitDomain(lut, size.width, size.height, size.depth);
}

}  // namespace

boost::shared_ptr<LUT> LUTFileReaderCSP::read(const std::string& filename) {
    beginRead();
    std::ifstream file(filename);
    if (!file) throw Exception("CSP LUT reader: unable to open file.");
    ItemSource items(file, lineNumber_);

    expectVersion(items);
    lut_ = makeTable(items);
    readShapers(items, *lut_);
    if (lut_->is1D()) {
        readCurve(items, *lut_, sampleCount_);
    } else {
        readLattice(items, *lut_, sampleCount_);
    }
    return lut_;
}

}  // namespace Orlith::LUT
