#include "orlith/table/TableFile.h"

#include <fmt/format.h>

#include <unistd.h>

#include <boost/algorithm/string/case_conv.hpp>
#include <cerrno>
#include <cmath>
#include <filesystem>
#include <stdexcept>
#include <system_error>

#include "lut/Exception.h"
#include "lut/evaluation/Range.h"
#include "lut/io/Registry.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;
namespace property = Orlith::Property;

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

void setReaderProperties(ol::LUTFileReader& reader, const ReadOptions& options) {
    const auto set = [&](const char* name, auto property) { reader.setProperty(name, property); };
    set("interchange",
        property::makeProperty<property::Int>("interchange", options.isStrict ? 0 : 1));
    set("format3DL", property::makeProperty<property::String>("format3DL", options.format3DL));
    set("outputBitDepth",
        property::makeProperty<property::Int>("outputBitDepth", options.outputBitDepth));
    set("normalizeOutput",
        property::makeProperty<property::Int>("normalizeOutput", options.normalizeOutput ? 1 : 0));
}

/// The place of a failure: the file, and the line where there is one.
std::string place(const std::string& name, const ol::LUTFileReader& reader) {
    return reader.lineNumber() == 0 ? name : fmt::format("{}:{}", name, reader.lineNumber());
}

/// Answers for the commonest mistakes in the system's words.
void expectReadableFile(const std::string& path, const std::string& name) {
    std::error_code ignored;
    if (std::filesystem::is_directory(path, ignored)) throw Failure(name + ": is a folder");
    if (access(path.c_str(), R_OK) != 0) {
        throw Failure(fmt::format("{}: {}", name, std::generic_category().message(errno)));
    }
}

/// The reason that a reader gives for its failure.
std::string reasonOf(const ol::LUTFileReader& reader) {
    const auto remarks = reader.remarks();
    return remarks.empty() ? "" : fmt::format(" ({})", remarks.back().text);
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

void warnOfRemarks(const Table& table) {
    for (const ol::Remark& remark : table.remarks) {
        const std::string line = remark.line == 0 ? "" : fmt::format(":{}", remark.line);
        warn(fmt::format("{}{}: {}", table.name, line, remark.text));
    }
}

std::string sampleCounts(const Table& table) {
    return fmt::format("{}: holds {} samples, its table has {} points", table.name,
                       table.samplesRead, table.pointCount);
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

std::string withDot(const std::string& extension) {
    return extension.empty() || extension.front() == '.' ? extension : "." + extension;
}

std::string formatOf(const std::string& path, const std::string& givenExtension) {
    std::string extension = givenExtension;
    if (extension.empty()) ol::splitExtension(path, nullptr, &extension);
    boost::algorithm::to_lower(extension, std::locale::classic());
    return extension;
}

bool isReadable(const std::string& extension) {
    try {
        return ol::createReader("", true, extension) != nullptr;
    } catch (const ol::Exception&) {
        return false;
    }
}

std::string formatProblem(const char* message, const std::string& extension, const char* option) {
    std::string text = message;
    if (const std::size_t place = text.find("%s"); place != std::string::npos) {
        text.replace(place, 2, extension);
    }
    return fmt::format("{} (name the format by {})", text, option);
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
    Table table;
    table.name = !name.empty() ? name : isStandardInput ? "standard input" : path;
    table.extension = formatOf(path, options.from);
    boost::shared_ptr<ol::LUTFileReader> reader;
    try {
        reader = ol::createReader(file, true, table.extension);
    } catch (const ol::Exception& exception) {
        throw Failure(fmt::format("{}: {}", table.name,
                                  formatProblem(exception.message(), table.extension, "--from")));
    }
    expectReadableFile(file, table.name);
    setReaderProperties(*reader, options);
    try {
        table.lut = reader->read(file);
    } catch (const ol::Exception& exception) {
        // The last remark is the failure's reason; those before may have led to it.
        table.remarks = reader->remarks();
        if (!table.remarks.empty()) table.remarks.pop_back();
        warnOfRemarks(table);
        throw Failure(fmt::format("{}: {}{}{}", place(table.name, *reader), exception.message(),
                                  reasonOf(*reader), adviceOn(file, options)));
    } catch (const std::length_error&) {
        throw Failure(
            fmt::format("{}: declares a size that no table can have", place(table.name, *reader)));
    } catch (const std::bad_alloc&) {
        throw Failure(
            fmt::format("{}: needs more memory than there is", place(table.name, *reader)));
    }
    table.samplesRead = reader->sampleCount();
    table.pointCount = pointCount(*table.lut);
    table.remarks = reader->remarks();
    return table;
}

Table readTableAndWarn(const std::string& path, const ReadOptions& options) {
    Table table = readTable(path, options);
    warnOfRemarks(table);
    if (table.samplesRead != table.pointCount) warn(sampleCounts(table));
    return table;
}

Table readWholeTable(const std::string& path, const ReadOptions& options) {
    Table table = readTable(path, options);
    if (!table.isFilled()) throw Failure(sampleCounts(table));
    warnOfRemarks(table);
    if (table.samplesRead != table.pointCount) warn(sampleCounts(table));
    return table;
}

Table readTableForColours(const std::string& path, const ReadOptions& options) {
    return options.isStrict ? readTableAndWarn(path, options) : readWholeTable(path, options);
}

}  // namespace orlith
