#include "orlith/table/WriteOptions.h"

#include <CLI/CLI.hpp>

#include "lut/RampFill.h"
#include "orlith/Options.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

constexpr int kDefaultPreLUTEntries = 1024;

}  // namespace

const std::vector<std::string>& bitDepthWords() {
    static const std::vector<std::string> words = {"4", "8", "10", "12", "16"};
    return words;
}

Options3DL WriteOptions::options3DL() const {
    Options3DL options;
    options.inputBits = bitDepth;
    options.outputBits = outputBitDepth == 0 ? bitDepth : outputBitDepth;
    options.clampOutput = clampOutput;
    options.dialect = format3DL;
    options.scale = static_cast<float>(scale.value_or(ol::ownScale(format3DL)));
    options.offset = static_cast<float>(offset.value_or(ol::ownOffset(format3DL)));
    return options;
}

void addWriteOptions(CLI::App& command, WriteOptions& options) {
    command
        .add_option_function<std::string>(
            "--bitdepth", [&](const std::string& text) { options.bitDepth = std::stoi(text); },
            "Bits of the input grid of a .3dl file (10)")
        ->check(CLI::IsMember(bitDepthWords()))
        ->type_name("BITS");
    std::vector<std::string> outputDepths = bitDepthWords();
    outputDepths.emplace_back("input");
    command
        .add_option_function<std::string>(
            "--output-bitdepth",
            [&](const std::string& text) {
                options.outputBitDepth = text == "input" ? 0 : std::stoi(text);
            },
            "Bits of the codes of a .3dl file, or input (default)")
        ->check(CLI::IsMember(outputDepths))
        ->type_name("BITS");
    command.add_flag("--clamp-output,!--no-clamp-output", options.clampOutput,
                     "Clamp the codes of a .3dl file to their bits (default)");
    command.add_option("--format-3dl", options.format3DL, "Dialect of a .3dl file")
        ->type_name("DIALECT")
        ->check(CLI::IsMember({"flame", "lustre", "scratch"}))
        ->capture_default_str();
    addReal(command, "--scale", "Multiplies the codes of a .3dl file",
            [&](double scale) { options.scale = scale; });
    addReal(command, "--offset", "Added to the codes of a .3dl file",
            [&](double offset) { options.offset = offset; });
    command
        .add_option_function<std::string>(
            "--lut1d", [&](const std::string& text) { options.lut1d = std::stoi(text); },
            "Entries of a pre-LUT by the book, of .cms and .cub files; 0: none")
        ->check(wrongPreLUTSize)
        ->type_name("N");
    command
        .add_option(
            "--style1d", options.style1d,
            "Ramp of that pre-LUT: linear, or logarithmic, which is a smooth step (default)")
        ->type_name("STYLE")
        ->check(CLI::IsMember({"linear", "logarithmic"}));
}

void addPreLUT(ol::LUT& lut, const WriteOptions& options) {
    if (!options.hasPreLUT()) return;
    if (!lut.inputShaper.empty() || !lut.outputShaper.empty()) return;
    setPreLUT(lut, options.lut1d.value_or(kDefaultPreLUTEntries),
              options.style1d.value_or("logarithmic"));
    lut.outputShaper.counts.fill(static_cast<float>(lut.outputShaper.entries.size()));
}

void setPreLUT(ol::LUT& lut, int entryCount, const std::string& style) {
    const auto fillRamp = style == "linear" ? ol::fillLinearRamp : ol::fillSmoothRamp;
    fillRamp(lut.outputShaper.entries, entryCount, 1);
}

}  // namespace orlith
