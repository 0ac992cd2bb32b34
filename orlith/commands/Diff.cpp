#include <fmt/format.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>

#include "lut/io/Lattice.h"
#include "orlith/Command.h"
#include "orlith/Facts.h"
#include "orlith/Options.h"
#include "orlith/TableFile.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

struct DiffOptions {
    std::string a;
    std::string b;
    ReadOptions reading;
    double tolerance = 0.0;
};

/// Differences of one channel.
class Differences {
public:
    void add(float a, float b) {
        ++count_;
        if (a == b || (std::isnan(a) && std::isnan(b))) return;
        double difference = std::fabs(static_cast<double>(a) - static_cast<double>(b));
        if (std::isnan(difference)) difference = std::numeric_limits<double>::infinity();
        largest_ = std::max(largest_, difference);
        sum_ += difference;
        squares_ += difference * difference;
    }

    double largest() const { return largest_; }
    double mean() const { return count_ == 0 ? 0.0 : sum_ / static_cast<double>(count_); }
    double rootMeanSquare() const {
        return count_ == 0 ? 0.0 : std::sqrt(squares_ / static_cast<double>(count_));
    }

private:
    std::uint64_t count_ = 0;
    double largest_ = 0.0;
    double sum_ = 0.0;
    double squares_ = 0.0;
};

bool sameSize(const ol::LUT& a, const ol::LUT& b) {
    if (a.is1D() || b.is1D()) return a.is1D() && b.is1D() && a.width() == b.width();
    return a.width() == b.width() && a.height() == b.height() && a.depth() == b.depth();
}

/// Calls visit(a's sample, b's sample) at the points of the larger table. The other table is
/// interpolated there, beyond its domain in straight lines.
template <class Visit>
void forEachPair(const Table& a, const Table& b, Visit&& visit) {
    if (sameSize(*a.lut, *b.lut)) {
        for (std::uint64_t i = 0; i < 3 * a.pointCount; ++i) {
            visit(static_cast<unsigned>(i % 3), a.lut->data()[i], b.lut->data()[i]);
        }
        return;
    }
    const bool isALarger = a.pointCount >= b.pointCount;
    const ol::LUT& larger = isALarger ? *a.lut : *b.lut;
    const ol::LUT& smaller = isALarger ? *b.lut : *a.lut;
    const ol::LatticeSize size =
        larger.is1D() ? ol::LatticeSize{larger.width(), 1, 1} : ol::LatticeSize::of(larger);
    ol::LatticePosition point;
    ol::forEachRedFastest(size, [&](std::size_t element) {
        const ol::RGB input = larger.is1D() ? inputColour(larger, point.r, point.r, point.r)
                                            : inputColour(larger, point.r, point.g, point.b);
        const ol::RGB there = smaller.interpolate(input, ol::Trilinear, true);
        for (unsigned c = 0; c < 3; ++c)
            visit(c, larger.data()[3 * element + c], there[c]);
        point.advanceRedFastest(size);
    });
}

/// --from is for the table whose name does not tell its format, if the other one's does.
ReadOptions readingOf(const std::string& path, const ReadOptions& options) {
    ReadOptions reading = options;
    if (isReadable(formatOf(path, ""))) reading.from.clear();
    return reading;
}

int runDiff(const DiffOptions& options) {
    if (options.a == "-" && options.b == "-") {
        throw UsageError("only one of the tables can come from standard input");
    }
    const Table a = readWholeTable(options.a, readingOf(options.a, options.reading));
    const Table b = readWholeTable(options.b, readingOf(options.b, options.reading));
    Differences channels[3];
    forEachPair(a, b, [&](unsigned c, float x, float y) { channels[c].add(x, y); });

    const char* const names[] = {"red", "green", "blue"};
    fmt::print("{:<8}{:>14}{:>14}{:>14}\n", "", "largest", "mean", "rms");
    bool isWithin = true;
    for (unsigned c = 0; c < 3; ++c) {
        fmt::print("{:<8}{:>14.6g}{:>14.6g}{:>14.6g}\n", names[c], channels[c].largest(),
                   channels[c].mean(), channels[c].rootMeanSquare());
        isWithin = isWithin && channels[c].largest() <= options.tolerance;
    }
    return isWithin ? kDone : kFailed;
}

}  // namespace

void addDiff(CLI::App& program, int& status) {
    CLI::App* const command = program.add_subcommand(
        "diff", "Compare two tables; exit status 1 where they differ by more than the tolerance");
    const auto options = std::make_shared<DiffOptions>();
    command->add_option("LUT_A", options->a, "Table to read")->required();
    command->add_option("LUT_B", options->b, "Table to compare it with")->required();
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
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
