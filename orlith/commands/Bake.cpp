#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <string>
#include <vector>

#include "lut/LUT3D.h"
#include "lut/evaluation/Deviation.h"
#include "lut/evaluation/Look.h"
#include "lut/io/interchange/Fitting.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "orlith/bake/ImageProgram.h"
#include "orlith/bake/ProgramLook.h"
#include "orlith/table/ColourOptions.h"
#include "orlith/table/TableFile.h"
#include "orlith/table/TableOutput.h"
#include "orlith/table/Verification.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

constexpr int kDefaultSize = 33;
constexpr int kLargestPattern = 129;

struct BakeOptions {
    std::vector<std::string> tables;
    int size = 0;  // 0: as the tables have it
    ReadOptions reading;
    ColourOptions colours;
    ProgramLook program;  // no words: none
    TableOutputOptions output;

    bool hasProgram() const { return !program.words.empty(); }
};

void expectSense(const BakeOptions& options) {
    if (options.tables.empty() && !options.hasProgram()) {
        throw UsageError("there is nothing to bake: give tables (--lut), or -- PROGRAM, or both");
    }
    if (std::count(options.tables.begin(), options.tables.end(), "-") > 1) {
        throw UsageError("only one of the tables can come from standard input");
    }
    if (!options.hasProgram()) return;
    expectImageWords(options.program.words);
    if (options.size > kLargestPattern) {
        throw UsageError(fmt::format("a pattern has at most {} points a side", kLargestPattern));
    }
}

/// Tables in a row.
struct TableRow {
    std::vector<Table> tables;
    ol::ColourWay look;  // of all; empty where there is none
};

TableRow readTables(const BakeOptions& options) {
    TableRow row;
    std::vector<ol::ColourWay> looks;
    for (const std::string& path : options.tables) {
        row.tables.push_back(readWholeTable(path, readingAmong(path, options.reading)));
        looks.push_back(
            wayThrough(row.tables.back().lut, options.colours, options.reading.isStrict));
    }
    if (looks.empty()) return row;
    row.look = [looks](float* rgb, std::size_t count) {
        for (const ol::ColourWay& each : looks)
            each(rgb, count);
    };
    return row;
}

/// Points a side where nobody has said.
int defaultSize(const TableRow& row, bool hasProgram) {
    int size = 0;
    for (const Table& each : row.tables) {
        const ol::LUT& lut = *each.lut;
        if (!hasProgram && !lut.is1D()) {
            size = std::max({size, lut.width(), lut.height(), lut.depth()});
        }
    }
    return size > 0 ? size : kDefaultSize;
}

/// The inputs that are baked if the format holds them: those of the first table. By the book a
/// table has no domain, and the pattern goes from 0 to 1.
ol::Range wantedInputs(const TableRow& row, const BakeOptions& options) {
    const bool isUnit = options.hasProgram() || options.reading.isStrict;
    return isUnit ? ol::unitRange() : inputRangeOf(*row.tables.front().lut);
}

/// A lattice without a look yet, of the size and the domain that the file is going to have.
/// @throws Failure  the format has no tables of that size
boost::shared_ptr<ol::LUT> makeLattice(const TableOutput& target, const TableRow& row,
                                       const BakeOptions& options) {
    const auto lattice = boost::make_shared<ol::LUT3D>();
    const int points = options.size > 0 ? options.size : defaultSize(row, options.hasProgram());
    lattice->resize(points);
    setDomain(*lattice, wantedInputs(row, options), {points, points, points});
    // The format has the last word, as on any table.
    return target.fit(lattice, options.size).lut;
}

void bakeTables(const TableRow& row, ol::LUT& lattice) {
    float* next = lattice.data();
    forEachInput(lattice, false,
                 [&](const ol::RGB& colour) { next = std::copy_n(colour.data_block(), 3, next); });
    row.look(lattice.data(), pointCount(lattice));
}

/// Colours that the first table tells apart, and the baked one does not.
void warnOfDomain(const TableRow& row, const ol::LUT& lattice) {
    if (row.tables.empty()) return;
    const ol::Range own = inputRangeOf(*row.tables.front().lut);
    const ol::Range baked = inputRangeOf(lattice);
    constexpr float kSlack = 1e-6F;
    for (unsigned c = 0; c < 3; ++c) {
        if (own.min[c] >= baked.min[c] - kSlack && own.max[c] <= baked.max[c] + kSlack) continue;
        return warn(fmt::format(
            "{}: its domain is {} to {}, what is baked covers {} to {}", row.tables.front().name,
            colourText(own.min.data_block()), colourText(own.max.data_block()),
            colourText(baked.min.data_block()), colourText(baked.max.data_block())));
    }
}

/// Numbers that the tables make and 16-bit images do not hold.
void warnOfClipping(const ol::LUT& baked, const std::string& imageType) {
    const float* const samples = baked.data();
    const auto count = static_cast<std::ptrdiff_t>(3 * pointCount(baked));
    const auto clipped = std::count_if(
        samples, samples + count, [](float sample) { return !(sample >= 0.0F && sample <= 1.0F); });
    if (clipped == 0) return;
    warn(
        fmt::format("{} of {} numbers behind the tables are below 0 or above 1, and clipped in"
                    " 16-bit {} images (--image-type exr keeps them)",
                    clipped, count, imageType));
}

int runBake(const BakeOptions& options) {
    expectSense(options);
    const TableOutput target(options.output, options.reading.isStrict);
    const TableRow row = readTables(options);
    ol::Fitted baked{makeLattice(target, row, options), "", false};
    warnOfDomain(row, *baked.lut);
    if (row.look) bakeTables(row, *baked.lut);

    OutputFile output(options.output.path);
    Origin origin;
    if (options.hasProgram()) {
        const ProgramLook& program = options.program;
        if (program.clips()) {
            warnOfClipping(*baked.lut, program.imageType);
            origin.causes.push_back(fmt::format("16-bit {} images", program.imageType));
        }
        baked.lut = bakeProgram(program, row.look, baked.lut->width());
        output.expectNotCancelled();
    } else {
        origin.judge = [&](const boost::shared_ptr<ol::LUT>& written) {
            const ol::TableLook tables{row.look, *row.tables.front().lut};
            const ol::TableLook file{wayThrough(written, options.colours, false), *written};
            return "from the tables " + deviationText(largestDeviation(tables, file));
        };
    }
    // A look may make what the format has no numbers for.
    if (!options.reading.isStrict) baked.lut = target.fit(baked.lut, 0).lut;
    origin.table = baked.lut;
    target.write(output, baked, origin);
    return kDone;
}

}  // namespace

void addBake(CLI::App& program, const std::vector<std::string>& programWords, int& status) {
    CLI::App* const command = addCommand(
        program, "bake", "Make one table of other tables, of an image program's look, or of both");
    const auto options = std::make_shared<BakeOptions>();
    command->footer(
        "-- PROGRAM ARG...           Image program, run as it is; {in} and {out} in its words are\n"
        "                            the images that it reads and writes");
    command->add_option("--lut", options->tables, "Table; several in their order, then PROGRAM")
        ->type_name("LUT")
        ->allow_extra_args(false);
    addInteger(*command, "--size", 2, 256,
               "Points a side; if not given, those of the largest table, or 33",
               [options](int size) { options->size = size; });
    command
        ->add_option("--image-type", options->program.imageType,
                     "Images for PROGRAM: exr (float), or tif, dpx, png (16 bits)")
        ->check(CLI::IsMember({"exr", "tif", "dpx", "png"}))
        ->default_val("exr");
    command->add_flag("--force", options->program.isForced,
                      "Take an image of PROGRAM that does not look like a pattern");
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
    addColourOptions(*command, options->colours);
    addTableOutputOptions(*command, options->output);
    command->callback([options, &programWords, &status] {
        options->program.words = programWords;
        status = runBake(*options);
    });
}

}  // namespace orlith
