#include "lut/io/table/Reading.h"

#include <unistd.h>

#include <cerrno>
#include <filesystem>
#include <new>
#include <stdexcept>
#include <system_error>

#include "lut/Exception.h"
#include "lut/evaluation/Range.h"
#include "lut/io/table/FileError.h"

namespace Orlith::LUT {
namespace {

namespace property = Orlith::Property;

void setReaderProperties(LUTFileReader& reader, const ReadOptions& options) {
    const auto set = [&](const char* name, auto property) { reader.setProperty(name, property); };
    set("interchange",
        property::makeProperty<property::Int>("interchange", options.isStrict ? 0 : 1));
    set("fileOrder",
        property::makeProperty<property::Int>("fileOrder", options.placesFewSamples ? 0 : 1));
    set("format3DL", property::makeProperty<property::String>("format3DL", options.format3DL));
    set("outputBitDepth",
        property::makeProperty<property::Int>("outputBitDepth", options.outputBitDepth));
    set("normalizeOutput",
        property::makeProperty<property::Int>("normalizeOutput", options.normalizeOutput ? 1 : 0));
}

/// The last remark is the failure's reason; those before may have led to it.
FileError failureOf(const LUTFileReader& reader, const Exception& exception,
                    const std::string& name) {
    auto remarks = reader.remarks();
    std::string reason = exception.message();
    if (!remarks.empty()) {
        reason += " (" + remarks.back().text + ")";
        remarks.pop_back();
    }
    return FileError(name, reader.lineNumber(), reason, remarks);
}

}  // namespace

void expectReadableFile(const std::string& path, const std::string& name) {
    if (name.empty()) throw FileError("a table", 0, "has no name");
    std::error_code ignored;
    if (std::filesystem::is_directory(path, ignored)) throw FileError(name, 0, "is a folder");
    if (access(path.c_str(), R_OK) != 0) {
        throw FileError(name, 0, std::generic_category().message(errno));
    }
}

Table readTable(LUTFileReader& reader, const std::string& path, const std::string& name,
                const ReadOptions& options) {
    Table table;
    table.name = name;
    setReaderProperties(reader, options);
    expectReadableFile(path, name);
    try {
        table.lut = reader.read(path);
    } catch (const Exception& exception) {
        throw failureOf(reader, exception, name);
    } catch (const std::length_error&) {
        throw FileError(name, reader.lineNumber(), "declares a size that no table can have");
    } catch (const std::bad_alloc&) {
        throw FileError(name, reader.lineNumber(), "needs more memory than there is");
    }
    table.samplesRead = reader.sampleCount();
    table.pointCount = pointCount(*table.lut);
    table.remarks = reader.remarks();
    return table;
}

std::string sampleCounts(const Table& table) {
    return "holds " + std::to_string(table.samplesRead) + " samples, its table has " +
           std::to_string(table.pointCount) + " points";
}

}  // namespace Orlith::LUT
