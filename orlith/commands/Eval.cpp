#include <fmt/format.h>

#include <iostream>
#include <map>
#include <string>
#include <vector>

#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"
#include "orlith/Command.h"
#include "orlith/Options.h"
#include "orlith/TableFile.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

struct EvalOptions {
    std::string path;
    ReadOptions reading;
    ol::InterpolationMode mode = ol::Trilinear;
    bool extrapolates = false;
    std::vector<std::string> colour;
};

/// A whole word as a number. Results are compared by machines: a misspelt colour is no black.
bool parseColour(std::string_view word, float& number) {
    double parsed = 0.0;
    if (!parseReal(word, parsed)) return false;
    number = ol::toFloat(word);  // 0 or infinity for numbers that single precision does not hold
    return true;
}

void evaluate(const ol::LUT& lut, const EvalOptions& options, const ol::RGB& colour) {
    const ol::RGB result = lut.interpolate(colour, options.mode, options.extrapolates);
    fmt::print("{}\n", colourText(result.data_block()));
}

void evaluateInput(const ol::LUT& lut, const EvalOptions& options) {
    std::string line;
    for (int number = 1; std::getline(std::cin, line); ++number) {
        const ol::Tokens words(ol::trim(line));
        if (words.empty()) continue;
        ol::RGB colour;
        bool isColour = words.count() == 3;
        for (unsigned c = 0; isColour && c < 3; ++c)
            isColour = parseColour(words[c], colour[c]);
        if (!isColour) {
            throw Failure(fmt::format("standard input:{}: expected three numbers", number));
        }
        evaluate(lut, options, colour);
    }
}

int runEval(const EvalOptions& options) {
    ol::RGB colour;
    for (unsigned c = 0; c < options.colour.size(); ++c) {
        if (!parseColour(options.colour[c], colour[c])) {
            throw UsageError(fmt::format("\"{}\" is not a number", options.colour[c]));
        }
    }
    if (options.path == "-" && options.colour.empty()) {
        throw UsageError("table and colours cannot both come from standard input");
    }
    const Table table = options.reading.isStrict ? readTableAndWarn(options.path, options.reading)
                                                 : readWholeTable(options.path, options.reading);
    if (options.colour.empty()) {
        evaluateInput(*table.lut, options);
    } else {
        evaluate(*table.lut, options, colour);
    }
    return kDone;
}

}  // namespace

void addEval(CLI::App& program, int& status) {
    CLI::App* const command = program.add_subcommand(
        "eval", "Send a colour, or each line of standard input, through a table");
    const auto options = std::make_shared<EvalOptions>();
    command->add_option("LUT", options->path, "Table to read")->required();
    command->add_option("COLOUR", options->colour, "Red, green and blue")->expected(3);
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
    const std::map<std::string, ol::InterpolationMode> modes = {{"step", ol::Step},
                                                                {"staggered", ol::LinearStaggered},
                                                                {"trilinear", ol::Trilinear},
                                                                {"cubic", ol::Cubic}};
    command->add_option("--mode", options->mode, "Interpolation of a lattice (trilinear)")
        ->transform(
            CLI::Transformer(modes, CLI::ignore_case).description("step|staggered|trilinear|cubic"))
        ->type_name("");
    command->add_flag("--extrapolate", options->extrapolates,
                      "Continue a lattice beyond its domain in straight lines");
    command->callback([options, &status] { status = runEval(*options); });
}

}  // namespace orlith
