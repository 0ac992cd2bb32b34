#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include "lut/evaluation/Look.h"
#include "lut/io/interchange/Fitting.h"
#include "lut/io/table/Proof.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "orlith/table/TableFile.h"
#include "orlith/table/TableOutput.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

struct ConvertOptions {
    std::string input;
    int size = 0;  // 0: the table's own
    ReadOptions reading;
    TableOutputOptions output;
};

std::string rangeText(const ol::Range& range) {
    return fmt::format("{:.6g} {:.6g} {:.6g} to {:.6g} {:.6g} {:.6g}", range.min[0], range.min[1],
                       range.min[2], range.max[0], range.max[1], range.max[2]);
}

/// By the book only samples are sure to be written.
void warnOfLosses(const std::string& name, const std::string& extension, const ol::LUT& lut) {
    const std::string lost = ol::whyNotHeld(lut, extension);
    if (lost != "a shaper" && lost != "its domain") return;
    warn(fmt::format("{}: a {} file does not hold the table's {}", name, extension,
                     lost == "a shaper" ? "pre-LUT" : "domain"));
}

int runConvert(const ConvertOptions& options) {
    const bool isStrict = options.reading.isStrict;
    const TableOutput target(options.output, isStrict);
    const Table table = readWholeTable(options.input, options.reading);
    ol::Fitted fitted{table.lut, "", false};
    if (isStrict) {
        ol::dropIdentityPreLUT(*table.lut);
        warnOfLosses(options.output.path, target.extension(), *table.lut);
    } else {
        fitted = target.fit(table.lut, options.size);
    }
    Origin origin{table.lut, {}, nullptr};
    if (!fitted.whyResampled.empty()) {
        origin.causes.push_back("resampled for " + fitted.whyResampled);
    }
    if (fitted.whyResampled == "a shaper") origin.causes.emplace_back("a .csp file keeps it");

    OutputFile output(options.output.path);
    if (fitted.losesInputs) {
        warn(fmt::format("{}: its domain changes from {}, to {}", output.name(),
                         rangeText(inputRangeOf(*table.lut)),
                         rangeText(inputRangeOf(*fitted.lut))));
    }
    target.write(output, fitted, origin);
    return kDone;
}

}  // namespace

void addConvert(CLI::App& program, int& status) {
    CLI::App* const command = addCommand(program, "convert", "Write a table in another format");
    const auto options = std::make_shared<ConvertOptions>();
    command->add_option("IN_LUT", options->input, "Table to read")->required();
    addFromOption(*command, options->reading);
    addInteger(*command, "--size", 2, 256, "Points a side; resamples a table of another size",
               [options](int size) { options->size = size; });
    addReadOptions(*command, options->reading);
    addTableOutputOptions(*command, options->output);
    command->callback([options, &status] { status = runConvert(*options); });
}

}  // namespace orlith
