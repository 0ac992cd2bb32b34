#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <cmath>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "orlith/Command.h"
#include "orlith/FactsInWords.h"
#include "orlith/Json.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/table/TableFile.h"
#include "report/Report.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

constexpr std::uint64_t kMostValues = std::uint64_t{1} << 24;

struct InfoOptions {
    std::string path;
    ReadOptions reading;
    bool isJson = false;
    bool showsValues = false;
};

/// What there is to see; nothing where the file did not fill the table, or it has no points.
std::optional<report::Report> look(const Table& table) {
    if (!table.isFilled() || table.pointCount == 0) return std::nullopt;
    return report::reportOn(table.lut);
}

// JSON

std::string jsonRange(const ol::RGB& min, const ol::RGB& max) {
    return fmt::format("{{\"min\": {}, \"max\": {}}}", jsonTriple(min.data_block()),
                       jsonTriple(max.data_block()));
}

std::string jsonShaper(const ol::Shaper& shaper) {
    if (shaper.empty()) return "null";
    std::string entries;
    for (const ol::RGB& entry : shaper.entries) {
        if (!entries.empty()) entries += ", ";
        entries += jsonTriple(entry.data_block());
    }
    return fmt::format("{{\"counts\": {}, \"entries\": [{}]}}",
                       jsonTriple(shaper.counts.data_block()), entries);
}

std::string jsonTransform(const ol::Transform& transform) {
    std::string rows;
    for (unsigned row = 0; row < 4; ++row) {
        if (row > 0) rows += ", ";
        rows += fmt::format("[{}, {}, {}, {}]", jsonNumber(transform[row][0]),
                            jsonNumber(transform[row][1]), jsonNumber(transform[row][2]),
                            jsonNumber(transform[row][3]));
    }
    return "[" + rows + "]";
}

std::string jsonRemarks(const Table& table) {
    std::string list;
    for (const ol::Remark& remark : table.remarks) {
        if (!list.empty()) list += ", ";
        list += fmt::format("{{\"line\": {}, \"text\": {}}}", remark.line, jsonText(remark.text));
    }
    return "[" + list + "]";
}

std::string jsonFault(const report::Fault& fault) {
    constexpr const char* kNames[] = {"red", "green", "blue"};
    std::string channels;
    for (unsigned c = 0; c < 3; ++c) {
        if (!fault.channels[c]) continue;
        if (!channels.empty()) channels += ", ";
        channels += jsonText(kNames[c]);
    }
    const std::string level = fault.kind == report::FaultKind::Clip
                                  ? fmt::format("\"level\": {}, ", jsonNumber(fault.level))
                                  : "";
    return fmt::format(
        "{{\"kind\": {}, \"channels\": [{}], \"from\": {}, \"to\": {}, \"amount\": {}, {}"
        "\"count\": {}, \"text\": {}}}",
        jsonText(nameOf(fault.kind)), channels, jsonTriple(fault.from.data_block()),
        jsonTriple(fault.to.data_block()), jsonNumber(static_cast<float>(fault.amount)), level,
        fault.count, jsonText(textOf(fault)));
}

std::string jsonFaults(const std::vector<report::Fault>& faults) {
    std::string list;
    for (const report::Fault& fault : faults) {
        if (!list.empty()) list += ",\n  ";
        list += jsonFault(fault);
    }
    return "[" + list + "]";
}

void printJson(const Table& table, const InfoOptions& options) {
    const ol::LUT& lut = *table.lut;
    ol::RGB min;
    ol::RGB max;
    lut.minmax(min, max);
    const auto found = look(table);
    const std::string size =
        lut.is1D() ? fmt::format("[{}]", lut.width())
                   : fmt::format("[{}, {}, {}]", lut.width(), lut.height(), lut.depth());
    fmt::print("{{\"file\": {}, \"format\": {}, \"kind\": \"{}\", \"size\": {},\n",
               jsonText(table.name), jsonText(table.extension), lut.is1D() ? "1D" : "3D", size);
    fmt::print(" \"samples_read\": {},\n", table.samplesRead);
    fmt::print(" \"transform\": {}, \"domain\": {},\n", jsonTransform(lut.transform),
               jsonRange(min, max));
    fmt::print(" \"inputShaper\": {}, \"outputShaper\": {},\n", jsonShaper(lut.inputShaper),
               jsonShaper(lut.outputShaper));
    fmt::print(" \"range\": {},\n", found ? jsonRange(found->facts.min, found->facts.max) : "null");
    fmt::print(" \"faults\": {},\n", found ? jsonFaults(found->faults) : "null");
    fmt::print(" \"remarks\": {}", jsonRemarks(table));
    if (options.showsValues) {
        fmt::print(",\n \"values\": [");
        for (std::uint64_t i = 0; i < table.pointCount; ++i) {
            fmt::print("{}{}", i == 0 ? "" : ", ", jsonTriple(lut.data() + 3 * i));
        }
        fmt::print("]");
    }
    fmt::print("}}\n");
}

// For a person

void printText(const Table& table, const InfoOptions& options) {
    const auto line = [](const std::string& name, const std::string& value) {
        fmt::print("{:<16}{}\n", name, value);
    };
    const auto found = look(table);
    for (const auto& [name, value] : factsInWords(table, found ? &*found : nullptr))
        line(name, value);
    if (found) {
        if (found->faults.empty()) line("faults", "none found");
        const char* name = "faults";
        for (const report::Fault& fault : found->faults) {
            line(name, textOf(fault));
            name = "";
        }
    }
    if (!options.showsValues) return;
    for (std::uint64_t i = 0; i < table.pointCount; ++i) {
        fmt::print("{}\n", colourText(table.lut->data() + 3 * i));
    }
}

/// Reads a table as meant; one whose file ends early by the book, so that there is something to
/// look at.
Table readAsFarAsItGoes(const std::string& path, const ReadOptions& options) {
    try {
        return readTableAndWarn(path, options);
    } catch (const Failure& failure) {
        ReadOptions byBook = options;
        byBook.isStrict = true;
        Table table;
        try {
            if (!options.isStrict && path != "-") table = readTable(path, byBook);
        } catch (const Failure&) {
        }
        if (!table.lut || table.isFilled()) throw;
        warn(failure.what());
        return table;
    }
}

int runInfo(const InfoOptions& options) {
    ReadOptions reading = options.reading;
    reading.placesFewSamples = options.showsValues;
    const Table table = readAsFarAsItGoes(options.path, reading);
    if (options.showsValues && table.pointCount > kMostValues) {
        throw Failure(fmt::format("{}: {} points are too many for --values (at most {})",
                                  table.name, table.pointCount, kMostValues));
    }
    if (options.isJson) {
        printJson(table, options);
    } else {
        printText(table, options);
    }
    return kDone;
}

}  // namespace

void addInfo(CLI::App& program, int& status) {
    CLI::App* const command = addCommand(program, "info", "Say what a table file holds");
    const auto options = std::make_shared<InfoOptions>();
    command->add_option("LUT", options->path, "Table to read")->required();
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
    command->add_flag("--json", options->isJson, "Print one JSON object");
    command->add_flag("--values", options->showsValues, "Print all samples, in storage order");
    command->callback([options, &status] { status = runInfo(*options); });
}

}  // namespace orlith
