#include "orlith/table/TableFile.h"

#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <cmath>
#include <filesystem>
#include <vector>

#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "lut/io/table/FileError.h"
#include "lut/io/table/Proof.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

/// "detect", "input" or a number of bits.
std::string parseOutputBitDepth(const std::string& text, int& bits) {
    if (text == "detect") {
        bits = ReadOptions::kDetect;
    } else if (text == "input") {
        bits = ReadOptions::kAsInput;
    } else if (!parseInteger(text, bits) || bits < 1 || bits > 31) {
        return "has to be detect, input or a number of bits from 1 to 31";
    }
    return "";
}

/// What by the book is no table may be one as its maker meant it.
std::string adviceOn(const std::string& file, const ReadOptions& options) {
    if (!options.isStrict || !std::filesystem::is_regular_file(file)) return "";
    ReadOptions asMeant = options;
    asMeant.isStrict = false;
    try {
        readTable(file, asMeant);
        return "; it can be read without --strict";
    } catch (const Failure&) {
        return "";
    }
}

void warnOfRemarks(const std::string& name, const std::vector<ol::Remark>& remarks) {
    for (const ol::Remark& remark : remarks) {
        const std::string line = remark.line == 0 ? "" : fmt::format(":{}", remark.line);
        warn(fmt::format("{}{}: {}", name, line, remark.text));
    }
}

/// A file that is not there has no format either.
boost::shared_ptr<ol::LUTFileReader> makeReader(const std::string& file, const std::string& name,
                                                const std::string& extension) {
    try {
        return ol::createReader("", true, extension);
    } catch (const ol::Exception& exception) {
        ol::expectReadableFile(file, name);
        throw Failure(
            fmt::format("{}: {}", name, formatProblem(exception.message(), extension, "--from")));
    }
}

void warnOfSurplus(const Table& table) {
    if (table.samplesRead == table.pointCount) return;
    warn(fmt::format("{}: {}", table.name, sampleCounts(table)));
}

}  // namespace

ReadOptions readingAmong(const std::string& path, const ReadOptions& options) {
    ReadOptions reading = options;
    if (isReadable(formatOf(path, ""))) reading.from.clear();
    return reading;
}

void addFromOption(CLI::App& command, ReadOptions& options) {
    command
        .add_option_function<std::string>(
            "--from", [&](const std::string& extension) { options.from = withDot(extension); },
            "Format of the file where its name does not tell, such as cube")
        ->type_name("EXT");
}

void addReadOptions(CLI::App& command, ReadOptions& options) {
    command.add_flag("--strict", options.isStrict,
                     "Go by the letter of the format, as the library's calls do");
    command
        .add_option("--read-format-3dl", options.format3DL, "Dialect of a .3dl file that is read")
        ->type_name("DIALECT")
        ->check(CLI::IsMember({"auto", "flame", "lustre", "scratch"}))
        ->capture_default_str();
    command
        .add_option_function<std::string>(
            "--read-output-bitdepth",
            [&](const std::string& text) {
                const std::string wrong = parseOutputBitDepth(text, options.outputBitDepth);
                if (!wrong.empty()) throw CLI::ValidationError("--read-output-bitdepth", wrong);
            },
            "Bits of the codes of a .3dl file that is read: detect (default), input or a number")
        ->type_name("BITS");
    command.add_flag("--normalize-output", options.normalizeOutput,
                     "Scale a .3dl file down whose codes exceed their bits");
}

bool isReadable(const std::string& extension) {
    try {
        return ol::createReader("", true, extension) != nullptr;
    } catch (const ol::Exception&) {
        return false;
    }
}

std::string sizeText(const ol::LUT& lut) {
    if (lut.is1D()) return fmt::format("{} entries", lut.width());
    return fmt::format("{} x {} x {} points", lut.width(), lut.height(), lut.depth());
}

std::string colourText(const float* rgb) {
    const auto text = [](float number) {
        return std::isnan(number) ? std::string("nan") : fmt::format("{}", number);
    };
    return fmt::format("{} {} {}", text(rgb[0]), text(rgb[1]), text(rgb[2]));
}

Table readTable(const std::string& path, const ReadOptions& options, const std::string& name) {
    const bool isStandardInput = path == "-";
    const std::string file = isStandardInput ? "/dev/stdin" : path;
    const std::string shown = !name.empty() ? name : isStandardInput ? "standard input" : path;
    const std::string extension = formatOf(path, options.from);
    try {
        const auto reader = makeReader(file, shown, extension);
        Table table = readTable(*reader, file, shown, options);
        table.extension = extension;
        return table;
    } catch (const ol::FileError& error) {
        warnOfRemarks(shown, error.remarks());
        throw Failure(error.what() + adviceOn(file, options));
    }
}

Table readTableAndWarn(const std::string& path, const ReadOptions& options) {
    Table table = readTable(path, options);
    warnOfRemarks(table.name, table.remarks);
    warnOfSurplus(table);
    return table;
}

Table readWholeTable(const std::string& path, const ReadOptions& options) {
    Table table = readTable(path, options);
    if (!table.isFilled()) throw Failure(fmt::format("{}: {}", table.name, sampleCounts(table)));
    warnOfRemarks(table.name, table.remarks);
    warnOfSurplus(table);
    if (!options.isStrict) ol::foldStraightPreLUT(*table.lut);
    return table;
}

Table readTableForColours(const std::string& path, const ReadOptions& options) {
    return options.isStrict ? readTableAndWarn(path, options) : readWholeTable(path, options);
}

}  // namespace orlith
