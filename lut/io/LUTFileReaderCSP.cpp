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

#include "lut/Exception.h"
#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "lut/io/Lattice.h"
#include "lut/io/ShaperEntries.h"
#include "lut/io/interchange/CSPInterchange.h"
#include "lut/io/text/LineSource.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kNoMoreEntries[] =
    "CSP LUT reader: syntax error while reading LUT data, expecting more data.";

/// This format's lines: trimmed; to one that ends in a backslash the next physical line is joined,
/// with a blank between them.
/// Deliberate: the backslash stays, as a word or the end of one, and a second one joins nothing.
/// Held by tests/data/read/csp.txt.
class ItemSource {
public:
    ItemSource(std::istream& text, std::uint64_t& lineNumber, LineFilter* filter)
        : lines_(text, lineNumber, filter) {}

    LineSource& lines() { return lines_; }

    /// A line of the header or a shaper, good until the next call. One that ends in a backslash is
    /// no keyword, and the number that it may begin with ends there: what was joined to it counts
    /// where words do.
    /// @return false at the end of the file, line is then empty
    bool next(std::string_view& line) {
        joined_ = {};
        if (!lines_.next(line) || !join(line)) return false;
        joined_ = trimEnd(joined_);
        return true;
    }

    /// What was joined to that line, mostly nothing.
    std::string_view joined() const { return joined_; }

    /// A sample: the first three numbers of a line.
    /// Deliberate: missing ones are 0, so that an empty line is a sample, and whatever follows them
    /// is ignored. Held by tests/data/read/csp.txt.
    /// @return false at the end of the file
    bool nextSample(float* sample) {
        std::string_view line;
        if (!lines_.next(line)) return false;
        RGB rgb;
        if (!lines_.parseTriple(line, rgb)) {
            if (!join(line)) return false;
            tokens_.split(line);
            tokens_.add(joined_);
            rgb = RGB(toFloat(tokens_[0]), toFloat(tokens_[1]), toFloat(tokens_[2]));
        }
        std::copy_n(rgb.data_block(), 3, sample);
        return true;
    }

private:
    /// Trims a line and looks for what is joined to it.
    /// @return false if the file ends where that should be, line is then empty
    bool join(std::string_view& line) {
        line = trim(line);
        joined_ = {};
        if (line.empty() || line.back() != '\\') return true;
        begin_.assign(line);
        line = {};
        if (!lines_.next(joined_)) return false;
        line = begin_;
        return true;
    }

    LineSource lines_;
    std::string begin_;  // the line that something is joined to
    std::string_view joined_;
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

/// One line of a shaper: the numbers of a channel. There is at least one, since a shaper line has a
/// word, so that a count of zero cannot agree with it.
void readRow(ItemSource& items, int pointCount, unsigned channel, ShaperEntries& entries) {
    const std::string_view line = expectShaperLine(items);
    // The count is a claim: room is made only for the numbers that are there.
    const std::size_t count = countWords(line) + countWords(items.joined());
    if (static_cast<std::int64_t>(count) != pointCount) {
        throw Exception(
            "CSP LUT reader: found different number of data elements than pre-LUT size specified.");
    }
    entries.grow(count);
    std::size_t entry = 0;
    std::string_view word;
    for (std::string_view text : {line, items.joined()}) {
        while (takeWord(text, word))
            entries[entry++][channel] = toFloat(word);
    }
}

/// Makes a shaper of three channels, the shorter ones continued with their last value.
void finish(ShaperEntries& entries, const std::array<int, 3>& pointCounts, Shaper& shaper) {
    for (unsigned c = 0; c < 3; ++c) {
        shaper.counts[c] = static_cast<float>(pointCounts[c]);
        const auto count = static_cast<std::size_t>(pointCounts[c]);
        for (std::size_t i = count; i < entries.size(); ++i)
            entries[i][c] = entries[count - 1][c];
    }
    entries.moveTo(shaper);
}

void readShapers(ItemSource& items, LUT& lut) {
    // Deliberate: without metadata the line in hand is red's count, comment mark or not. Held by
    // tests/data/read/csp.txt.
    std::string_view countLine = nextFilled(items);
    if (countLine == "BEGIN METADATA") {
        skipMetadata(items);
        countLine = expectShaperLine(items);
    }
    std::array<int, 3> pointCounts;
    ShaperEntries inputs;
    ShaperEntries outputs;
    for (unsigned c = 0; c < 3; ++c) {
        if (c > 0) countLine = expectShaperLine(items);
        pointCounts[c] = toInt(countLine);
        readRow(items, pointCounts[c], c, inputs);
        readRow(items, pointCounts[c], c, outputs);
    }
    finish(inputs, pointCounts, lut.inputShaper);
    finish(outputs, pointCounts, lut.outputShaper);
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
    Tokens tokens(nextFilled(items));
    tokens.add(items.joined());
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
    if (!file) failToOpen("CSP LUT reader: unable to open file.");
    CSPInterchange meant(reading());
    ItemSource items(file, lineNumber_, &meant);
    return meant.explainFailures([&] {
        expectVersion(items);
        lut_ = makeTable(items);
        readShapers(items, *lut_);
        meant.takeShapers(*lut_);
        if (lut_->is1D()) {
            readCurve(items, *lut_, sampleCount_);
        } else {
            readLattice(items, *lut_, sampleCount_);
        }
        meant.expectAllSamples(*lut_, items.lines());
        return lut_;
    });
}

}  // namespace Orlith::LUT
