#include "orlith/table/Verification.h"

#include <fmt/format.h>

#include <algorithm>
#include <cmath>
#include <optional>

#include "lut/evaluation/Range.h"
#include "lut/io/BLUTLayout.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/table/TableFile.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

/// Half a unit of the sixth digit, and the roundings of a float on its way through text.
double textTolerance(double value) {
    return 0.5e-6 + std::fabs(value) * 1.2e-7;
}

bool isSame(float a, float b) {
    return a == b || (std::isnan(a) && std::isnan(b));
}

/// The code behind a value that a .3dl reader gave: it takes Scratch's own scale and offset off.
double codeBehind(double value, const Options3DL& options) {
    const double codeMax = std::ldexp(1.0, options.outputBits) - 1.0;
    const bool isScratch = options.dialect == "scratch";
    return value * codeMax * (isScratch ? static_cast<double>(0.97979796F) : 1.0) +
           (isScratch ? 15.0 : 0.0);
}

bool agrees(float read, float written, const std::string& extension, const Options3DL& options) {
    const auto readValue = static_cast<double>(read);
    const auto writtenValue = static_cast<double>(written);
    if (extension == ".3dl") {
        const double code = codeOf(writtenValue, options);
        // Half a code, and what single precision leaves of large ones.
        return std::fabs(codeBehind(readValue, options) - code) <=
               0.5 + 1e-6 * std::fabs(code) + 1e-4;
    }
    if (isSame(read, written)) return true;
    return extension != ".blut" &&
           std::fabs(readValue - writtenValue) <= textTolerance(writtenValue);
}

bool sameSize(const ol::LUT& a, const ol::LUT& b) {
    if (a.is1D() != b.is1D() || a.width() != b.width()) return false;
    return a.is1D() || (a.height() == b.height() && a.depth() == b.depth());
}

/// Compares the pre-LUT, where the format keeps the table's outputShaper as it is.
void verifyPreLUT(const std::string& name, const std::string& extension, const ol::LUT& read,
                  const ol::LUT& table) {
    const bool isKept = extension == ".cub" || extension == ".cms";
    if (!isKept) return;
    const auto& written = table.outputShaper.entries;
    const auto& found = read.outputShaper.entries;
    // A .cms reader divides its pre-LUT by the points of a side.
    const double unit = extension == ".cms" ? table.width() : 1.0;
    bool agreesAll = found.size() == written.size();
    for (std::size_t i = 0; agreesAll && i < written.size(); ++i) {
        for (unsigned c = 0; c < 3; ++c) {
            const auto value = static_cast<double>(written[i][c]);
            const double back = static_cast<double>(found[i][c]) * unit;
            const bool same = back == value || (std::isnan(back) && std::isnan(value));
            agreesAll =
                agreesAll && (same || std::fabs(back - value) <= textTolerance(value) * 2.0);
        }
    }
    if (!agreesAll) throw Failure(name + ": read back, its pre-LUT differs from the table's");
}

Table readBack(const std::string& path, const ReadOptions& options, const std::string& name) {
    try {
        return readTable(path, options, name);
    } catch (const Failure& failure) {
        throw Failure(fmt::format("{} (while reading back what was written)", failure.what()));
    }
}

}  // namespace

std::string whyUnreadable(const std::string& extension, const ol::LUT& table) {
    if (extension != ".blut" || table.width() <= ol::kBLUTMostPoints) return "";
    return fmt::format("a .blut file of more than {} points a side cannot be read",
                       ol::kBLUTMostPoints);
}

std::string clippingText(const ol::LUT& lut, const std::string& extension,
                         const Options3DL& options) {
    const ol::Clipping clipping = clippingOf(lut, extension, options);
    if (clipping.numberCount == 0) return "";
    return fmt::format("clipped: {} numbers, the farthest {}", clipping.numberCount,
                       clipping.farthest);
}

double verify(const std::string& path, const std::string& name, const std::string& extension,
              const ol::LUT& table, const Options3DL& options, bool isByBook) {
    ReadOptions reading = readingOf(extension, options);
    reading.isStrict = true;
    const Table back = readBack(path, reading, name);
    if (!sameSize(*back.lut, table)) {
        throw Failure(fmt::format("{}: read back, it has {} instead of {}", name,
                                  sizeText(*back.lut), sizeText(table)));
    }
    if (back.samplesRead != back.pointCount) {
        throw Failure(fmt::format("{}: read back, it holds {} samples instead of {}", name,
                                  back.samplesRead, back.pointCount));
    }
    const float* const read = back.lut->data();
    const float* const written = table.data();
    double largest = 0.0;
    for (std::uint64_t i = 0; i < 3 * back.pointCount; ++i) {
        if (!agrees(read[i], written[i], extension, options)) {
            throw Failure(fmt::format("{}: read back, sample {} is {} instead of {}", name, i / 3,
                                      read[i], written[i]));
        }
        const double deviation =
            std::fabs(static_cast<double>(read[i]) - static_cast<double>(written[i]));
        if (deviation > largest) largest = deviation;
    }
    if (isByBook) verifyPreLUT(name, extension, *back.lut, table);
    return largest;
}

std::string deviationText(double deviation) {
    const std::string nearest = fmt::format("{:.1e}", deviation);  // "5.4e-07"
    double shown = 0.0;
    parseReal(nearest, shown);
    if (shown < deviation) {
        double unit = 0.0;  // of the first digit
        parseReal("1" + nearest.substr(nearest.find('e')), unit);
        shown += 0.1 * unit;
    }
    return fmt::format("{:.2g}", shown);
}

std::string summary(const std::string& name, const std::string& extension, const ol::LUT& table,
                    const std::string& outcome) {
    return fmt::format("{}: {}, {}, {}\n", printable(name), extension, sizeText(table), outcome);
}

}  // namespace orlith
