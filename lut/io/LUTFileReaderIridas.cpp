// Iridas cube (.cube, .itx): text, red fastest.
//
//   TITLE "anything"        ignored
//   # comment               the mark has to stand alone
//   LUT_3D_SIZE 2           points along each axis (or LUT_1D_SIZE: entries of a curve)
//   DOMAIN_MIN 0 0 0        ignored, as is DOMAIN_MAX: the table always covers 0 to 1
//   0.0 0.0 0.0             sample (0, 0, 0)
//   1.0 0.0 0.0             sample (1, 0, 0)
//   ...
//
// Lines are deliberately not trimmed. Surplus samples of a lattice start over from its first point,
// missing ones stay zero; a curve's file is read up to its last entry.

#include "lut/io/LUTFileReaderIridas.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <fstream>

#include "lut/Exception.h"
#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "lut/io/Lattice.h"
#include "lut/io/interchange/CubeInterchange.h"
#include "lut/io/text/LineSource.h"
#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"

namespace Orlith::LUT {
namespace {

constexpr char kDataError[] = "Iridas LUT reader: syntax error while reading LUT data.";

/// The table of the latest size line, and where the next sample goes. A second size line replaces
/// the table and leaves the position.
class Target {
public:
    boost::shared_ptr<LUT> start(std::string_view keyword, std::string_view sizeToken) {
        lut_ = keyword == "LUT_3D_SIZE" ? boost::shared_ptr<LUT>(boost::make_shared<LUT3D>())
                                        : boost::shared_ptr<LUT>(boost::make_shared<LUT1D>());
        size_ = toInt(sizeToken);
        if (size_ <= 0) throw Exception("Iridas LUT reader: syntax error while reading LUT size.");
        lut_->resize(size_);
        samples_ = lut_->data();
        return lut_;
    }

    void expectTable() const {
        if (!lut_) throw Exception("Iridas LUT reader: LUT failed to initialise.");
    }

    /// Stores a sample.
    /// @return false after the last entry of a curve
    bool store(const RGB& rgb) {
        const LatticeSize lattice{size_, size_, size_};
        const bool isCurve = lut_->is1D();
        if (!(isCurve ? entry_ < size_ : point_.isInside(lattice))) throw Exception(kDataError);
        const std::size_t element =
            isCurve ? static_cast<std::size_t>(entry_) : point_.element(lattice);
        std::copy_n(rgb.data_block(), 3, samples_ + 3 * element);
        if (isCurve) return ++entry_ < size_;
        point_.advanceRedFastest(lattice);
        return true;
    }

    boost::shared_ptr<LUT> finish() {
        expectTable();
        setUnitDomain(*lut_, size_, size_, size_);
        return lut_;
    }

private:
    boost::shared_ptr<LUT> lut_;
    float* samples_ = nullptr;
    int size_ = 0;
    LatticePosition point_;
    int entry_ = 0;
};

bool isIgnored(std::string_view keyword) {
    return keyword.empty() || keyword == "#" || keyword == "TITLE" || keyword == "DOMAIN_MIN" ||
           keyword == "DOMAIN_MAX";
}

bool isSize(std::string_view keyword) {
    return keyword == "LUT_3D_SIZE" || keyword == "LUT_1D_SIZE";
}

}  // namespace

boost::shared_ptr<LUT> LUTFileReaderIridas::read(const std::string& filename) {
    beginRead();
    std::ifstream file(filename);
    if (!file) failToOpen("Iridas LUT reader: unable to open file.");
    CubeInterchange meant(reading());
    LineSource lines(file, lineNumber_, &meant);
    return meant.explainFailures([&] {
        auto lut = readTable(lines);
        meant.finish(*lut, lines);
        return lut;
    });
}

boost::shared_ptr<LUT> LUTFileReaderIridas::readTable(LineSource& lines) {
    Target target;
    std::string_view line;
    Tokens tokens;
    RGB rgb;
    while (lines.next(line)) {
        const bool isPlain = lines.parseTriple(line, rgb);
        if (!isPlain) {
            tokens.split(line);
            if (isIgnored(tokens[0])) continue;
            if (isSize(tokens[0])) {
                lut_ = target.start(tokens[0], tokens[1]);
                continue;
            }
        }
        target.expectTable();
        if (!isPlain) {
            if (tokens.count() != 3) throw Exception(kDataError);
            rgb = RGB(toFloat(tokens[0]), toFloat(tokens[1]), toFloat(tokens[2]));
        }
        const bool goesOn = target.store(rgb);
        ++sampleCount_;
        if (!goesOn) break;
    }
    return target.finish();
}

}  // namespace Orlith::LUT
