#include "orlith/TableFile.h"

#include <fmt/format.h>

#include <cmath>
#include <filesystem>
#include <stdexcept>

#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "orlith/Command.h"

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
    } else if (!CLI::detail::lexical_cast(text, bits) || bits < 1 || bits > 31) {
        return "has to be detect, input or a number of bits from 1 to 31";
    }
    return "";
}

void setReaderProperties(ol::LUTFileReader& reader, const ReadOptions& options) {
    const auto set = [&](const char* name, auto property) { reader.setProperty(name, property); };
    set("format3DL", property::makeProperty<property::String>("format3DL", options.format3DL));
    set("outputBitDepth",
        property::makeProperty<property::Int>("outputBitDepth", options.outputBitDepth));
    set("normalizeOutput",
        property::makeProperty<property::Int>("normalizeOutput", options.normalizeOutput ? 1 : 0));
}

/// The place of a failure: the path, and the line where there is one.
std::string place(const std::string& path, const ol::LUTFileReader& reader) {
    return reader.lineNumber() == 0 ? path : fmt::format("{}:{}", path, reader.lineNumber());
}

}  // namespace

void addFromOption(CLI::App& command, ReadOptions& options) {
    options.hasFromOption = true;
    command
        .add_option_function<std::string>(
            "--from", [&](const std::string& extension) { options.from = withDot(extension); },
            "Format of the file where its name does not tell, such as cube")
        ->type_name("EXT");
}

void addReadOptions(CLI::App& command, ReadOptions& options) {
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
    if (!givenExtension.empty()) return givenExtension;
    std::string extension;
    ol::splitExtension(path, nullptr, &extension);
    return extension;
}

std::uint64_t pointCount(const ol::LUT& lut) {
    const auto width = static_cast<std::uint64_t>(lut.width());
    if (lut.is1D()) return width;
    return width * static_cast<std::uint64_t>(lut.height()) *
           static_cast<std::uint64_t>(lut.depth());
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

Table readTable(const std::string& path, const ReadOptions& options) {
    Table table;
    table.extension = formatOf(path, options.from);
    boost::shared_ptr<ol::LUTFileReader> reader;
    try {
        reader = ol::createReader(path, !options.from.empty(), options.from);
    } catch (const ol::Exception& exception) {
        throw Failure(fmt::format("{}: {} (\"{}\"{})", path, exception.message(), table.extension,
                                  options.hasFromOption ? "; name the format by --from" : ""));
    }
    if (std::filesystem::is_directory(path)) throw Failure(path + ": is a folder");
    setReaderProperties(*reader, options);
    try {
        table.lut = reader->read(path);
    } catch (const ol::Exception& exception) {
        throw Failure(fmt::format("{}: {}", place(path, *reader), exception.message()));
    } catch (const std::length_error&) {
        throw Failure(
            fmt::format("{}: declares a size that no table can have", place(path, *reader)));
    } catch (const std::bad_alloc&) {
        throw Failure(fmt::format("{}: needs more memory than there is", place(path, *reader)));
    }
    table.samplesRead = reader->sampleCount();
    table.pointCount = pointCount(*table.lut);
    return table;
}

Table readTableAndWarn(const std::string& path, const ReadOptions& options) {
    Table table = readTable(path, options);
    if (table.samplesRead != table.pointCount) {
        warn(fmt::format("{}: holds {} samples, its table has {} points", path, table.samplesRead,
                         table.pointCount));
    }
    return table;
}

}  // namespace orlith
