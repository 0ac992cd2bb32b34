#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <algorithm>
#include <array>
#include <cstdio>
#include <iostream>
#include <string>
#include <string_view>
#include <vector>

#include "lut/io/text/Numbers.h"
#include "lut/io/text/Tokens.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/table/ColourOptions.h"
#include "orlith/table/TableFile.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

constexpr std::string_view kByteOrderMark = "\xef\xbb\xbf";

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

/// Prints what becomes of the colours, and forgets them.
void evaluate(const ColourWay& way, std::vector<float>& colours) {
    way(colours.data(), colours.size() / 3);
    for (std::size_t i = 0; i < colours.size(); i += 3)
        fmt::print("{}\n", colourText(&colours[i]));
    colours.clear();
}

/// "0,5 0,25 1": three words, and no comma but within a number. Others stand between numbers.
bool hasDecimalCommas(std::string_view line) {
    const ol::Tokens words(line);
    const auto isNumber = [&](unsigned c) {
        return words[c].find(',') == std::string_view::npos || ol::hasDecimalComma(words[c]);
    };
    return words.count() == 3 && isNumber(0) && isNumber(1) && isNumber(2);
}

/// Takes the line's colour, if it has one.
/// @return false  it has something else
bool addColour(std::string line, std::vector<float>& colours) {
    const char instead = hasDecimalCommas(line) ? '.' : ' ';
    std::replace(line.begin(), line.end(), ',', instead);
    std::replace(line.begin(), line.end(), ';', ' ');
    const ol::Tokens words(line);
    if (words.empty() || words[0][0] == '#') return true;
    if (words.count() != 3) return false;
    std::array<float, 3> colour{};
    for (unsigned c = 0; c < 3; ++c)
        if (!parseColour(words[c], colour[c])) return false;
    colours.insert(colours.end(), colour.begin(), colour.end());
    return true;
}

/// Takes colours together as long as more are waiting; whoever waits for an answer gets it at once.
void evaluateInput(const ColourWay& way) {
    constexpr std::size_t kMostFloats = std::size_t{3} * 4096;
    std::ios::sync_with_stdio(false);  // so that the stream knows what is waiting
    std::vector<float> colours;
    std::string line;
    for (int number = 1; std::getline(std::cin, line); ++number) {
        if (number == 1 && line.rfind(kByteOrderMark, 0) == 0) line.erase(0, kByteOrderMark.size());
        const bool isColour = addColour(std::string(ol::trim(line)), colours);
        const bool isWaitedFor = std::cin.rdbuf()->in_avail() <= 0;
        if (!isColour || isWaitedFor || colours.size() >= kMostFloats) evaluate(way, colours);
        if (!isColour) {
            constexpr std::size_t kMostShown = 60;
            throw Failure(fmt::format("standard input:{}: \"{}\" is not three numbers", number,
                                      printable(ol::trim(line).substr(0, kMostShown))));
        }
        if (isWaitedFor) std::fflush(stdout);
    }
    evaluate(way, colours);
    if (std::cin.bad()) throw Failure("standard input cannot be read");
}

int runEval(const EvalOptions& options) {
    const std::string words = fmt::format("{}", fmt::join(options.colour, " "));
    std::vector<float> colour;
    if (!addColour(words, colour) || colour.empty() != options.colour.empty()) {
        throw UsageError(fmt::format("\"{}\" is not three numbers", words));
    }
    if (options.path == "-" && options.colour.empty()) {
        throw UsageError("table and colours cannot both come from standard input");
    }
    const Table table = readTableForColours(options.path, options.reading);
    const ColourWay way = wayThrough(table.lut, options.colours, options.reading.isStrict);
    if (colour.empty()) {
        evaluateInput(way);
    } else {
        evaluate(way, colour);
    }
    return kDone;
}

}  // namespace

void addEval(CLI::App& program, int& status) {
    CLI::App* const command = addCommand(
        program, "eval", "Send a colour, or each line of standard input, through a table");
    const auto options = std::make_shared<EvalOptions>();
    command->add_option("LUT", options->path, "Table to read")->required();
    command->add_option("COLOUR", options->colour, "Red, green and blue")->expected(1, 3);
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
    addColourOptions(*command, options->colours);
    command->callback([options, &status] { status = runEval(*options); });
}

}  // namespace orlith
