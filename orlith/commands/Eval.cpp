#include <fmt/format.h>

#include <functional>
#include <iostream>
#include <string>
#include <vector>

#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"
#include "orlith/Command.h"
#include "orlith/Options.h"
#include "orlith/table/ColourOptions.h"
#include "orlith/table/TableFile.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

struct EvalOptions {
    std::string path;
    ReadOptions reading;
    ColourOptions colours;
    std::vector<std::string> colour;
};

/// A whole word as a number. Results are compared by machines: a misspelt colour is no black.
bool parseColour(std::string_view word, float& number) {
    double parsed = 0.0;
    if (!parseReal(word, parsed)) return false;
    number = ol::toFloat(word);  // 0 or infinity for numbers that single precision does not hold
    return true;
}

void print(const ol::RGB& colour) {
    fmt::print("{}\n", colourText(colour.data_block()));
}

/// The way of one colour through the table: as its maker means it, or by the book.
std::function<ol::RGB(const ol::RGB&)> wayThrough(const Table& table, const EvalOptions& options) {
    const ColourOptions& colours = options.colours;
    if (options.reading.isStrict) {
        return [lut = table.lut, mode = colours.bookMode(), extrapolates = colours.extrapolates](
                   const ol::RGB& colour) { return lut->interpolate(colour, mode, extrapolates); };
    }
    return [evaluator = colours.evaluator(table.lut)](const ol::RGB& colour) {
        ol::RGB result;
        evaluator.apply(colour.data_block(), result.data_block(), 1);
        return result;
    };
}

void evaluateInput(const std::function<ol::RGB(const ol::RGB&)>& way) {
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
        print(way(colour));
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
    const auto way = wayThrough(table, options);
    if (options.colour.empty()) {
        evaluateInput(way);
    } else {
        print(way(colour));
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
    addColourOptions(*command, options->colours);
    command->callback([options, &status] { status = runEval(*options); });
}

}  // namespace orlith
