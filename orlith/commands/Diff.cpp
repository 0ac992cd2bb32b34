#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <algorithm>
#include <cmath>
#include <cstdint>

#include "lut/evaluation/Look.h"
#include "lut/io/Lattice.h"
#include "orlith/Command.h"
#include "orlith/Json.h"
#include "orlith/Options.h"
#include "orlith/table/ColourOptions.h"
#include "orlith/table/TableFile.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

struct DiffOptions {
    std::string a;
    std::string b;
    ReadOptions reading;
    ColourOptions colours;
    double tolerance = 0.0;
    bool isJson = false;
};

constexpr const char* kChannels[] = {"red", "green", "blue"};

bool sameSize(const ol::LUT& a, const ol::LUT& b) {
    if (a.is1D() || b.is1D()) return a.is1D() && b.is1D() && a.width() == b.width();
    return a.width() == b.width() && a.height() == b.height() && a.depth() == b.depth();
}

/// The input colour that a place of a table stands for: lattice point (r, g, b), or entry i of a
/// curve on all three channels.
ol::RGB inputColour(const ol::LUT& lut, int r, int g, int b) {
    const int index[] = {r, g, b};
    ol::RGB colour;
    for (unsigned c = 0; c < 3; ++c) {
        colour[c] = static_cast<float>(index[c]) * lut.transform[c][c] + lut.transform[3][c];
    }
    return colour;
}

/// By the book: sample by sample; where sizes differ, at the points of the larger table, where the
/// other is interpolated, beyond its domain in straight lines.
ol::Differences compareSamples(const Table& a, const Table& b) {
    ol::Differences differences;
    const bool isALarger = a.pointCount >= b.pointCount;
    const ol::LUT& larger = isALarger ? *a.lut : *b.lut;
    const ol::LUT& smaller = isALarger ? *b.lut : *a.lut;
    const bool isAsLarge = sameSize(larger, smaller);
    const ol::LatticeSize size =
        larger.is1D() ? ol::LatticeSize{larger.width(), 1, 1} : ol::LatticeSize::of(larger);
    ol::LatticePosition point;
    ol::forEachRedFastest(size, [&](std::size_t element) {
        const ol::RGB input = larger.is1D() ? inputColour(larger, point.r, point.r, point.r)
                                            : inputColour(larger, point.r, point.g, point.b);
        ol::RGB there;
        if (isAsLarge) {
            std::copy_n(smaller.data() + 3 * element, 3, there.data_block());
        } else {
            there = smaller.interpolate(input, ol::Trilinear, true);
        }
        for (unsigned c = 0; c < 3; ++c)
            addDifference(differences[c], larger.data()[3 * element + c], there[c], input);
        point.advanceRedFastest(size);
    });
    finishDifferences(differences, std::max(a.pointCount, b.pointCount));
    return differences;
}

void printText(const ol::Differences& differences) {
    fmt::print("{:<8}{:>14}{:>14}{:>14}  {}\n", "", "largest", "mean", "rms", "largest at");
    for (unsigned c = 0; c < 3; ++c) {
        const ol::Difference& each = differences[c];
        fmt::print("{:<8}{:>14.6g}{:>14.6g}{:>14.6g}  {}\n", kChannels[c], each.largest, each.mean,
                   each.rootMeanSquare,
                   each.largest > 0.0 ? colourText(each.at.data_block()) : "-");
    }
}

void printJson(const ol::Differences& differences, bool isWithin) {
    const auto number = [](double value) {
        return std::isfinite(value) ? fmt::format("{}", value) : std::string("\"inf\"");
    };
    fmt::print("{{\"within_tolerance\": {}", isWithin);
    for (unsigned c = 0; c < 3; ++c) {
        const ol::Difference& each = differences[c];
        fmt::print(",\n \"{}\": {{\"largest\": {}, \"at\": {}, \"mean\": {}, \"rms\": {}}}",
                   kChannels[c], number(each.largest), jsonTriple(each.at.data_block()),
                   number(each.mean), number(each.rootMeanSquare));
    }
    fmt::print("}}\n");
}

int runDiff(const DiffOptions& options) {
    if (options.a == "-" && options.b == "-") {
        throw UsageError("only one of the tables can come from standard input");
    }
    const Table a = readWholeTable(options.a, readingAmong(options.a, options.reading));
    const Table b = readWholeTable(options.b, readingAmong(options.b, options.reading));
    const ol::Differences differences =
        options.reading.isStrict
            ? compareSamples(a, b)
            : ol::compareLooks(*a.lut, wayThrough(a.lut, options.colours, false), *b.lut,
                               wayThrough(b.lut, options.colours, false));
    const bool isWithin = largestOf(differences) <= options.tolerance;
    if (options.isJson) {
        printJson(differences, isWithin);
    } else {
        printText(differences);
    }
    return isWithin ? kDone : kFailed;
}

}  // namespace

void addDiff(CLI::App& program, int& status) {
    CLI::App* const command = addCommand(
        program, "diff",
        "Compare two tables; exit status 1 where they differ by more than the tolerance");
    const auto options = std::make_shared<DiffOptions>();
    command->add_option("LUT_A", options->a, "Table to read")->required();
    command->add_option("LUT_B", options->b, "Table to compare it with")->required();
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
    addColourOptions(*command, options->colours);
    command->add_flag("--json", options->isJson, "Print one JSON object");
    addReal(*command, "--tolerance", "Largest difference that is none, from 0 on (0)",
            [options](double tolerance) {
                if (tolerance < 0.0) {
                    throw CLI::ValidationError("--tolerance", "has to be a number from 0 on");
                }
                options->tolerance = tolerance;
            });
    command->callback([options, &status] { status = runDiff(*options); });
}

}  // namespace orlith
