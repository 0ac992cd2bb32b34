#include "lut/io/Registry.h"

#include <gtest/gtest.h>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr char kNoReader[] = "No reader found for extension \"%s\".";
constexpr char kNoWriter[] = "No writer found for extension \"%s\".";

/// What an extension gives: a reader, known by its words about a file that is not there, and a
/// writer, known by the first bytes that it writes; or the messages that refuse them.
const struct {
    const char *extension, *readerSays, *writerBegins;
} kExtensions[] = {
    {".cube", "Iridas LUT reader: unable to open file.", "TITLE \"Gen"},
    {".itx", "Iridas LUT reader: unable to open file.", kNoWriter},
    {".cub", "Truelight LUT reader: unable to open file.", "# Truelight"},
    {".3dl", "3DL file reader: unable to find 3DL format to read", "# Generated"},
    {".vf", "VF file reader: unable to open file.", "#Inventor V"},
    {".gz", "VF file reader: unable to open file.", "#Inventor V"},
    {".vfz", "VF file reader: unable to open file.", "#Inventor V"},
    {".csp", "CSP LUT reader: unable to open file.", "CSPLUTV100\n"},
    {".cms", "CMS LUT reader: unable to open file.", "NUCODA_3D_C"},
    {".blut", "BLUT LUT reader: unable to open file.", "HLUT"},
    {".icc", "reader not found", "writer not found"},
    {".CUBE", kNoReader, kNoWriter},
    {".cubes", kNoReader, kNoWriter},
    {".", kNoReader, kNoWriter},
    {"", kNoReader, kNoWriter},
};

/// The first bytes that a writer writes.
std::string beginOf(ol::LUTFileWriter& writer, std::size_t byteCount) {
    const TempFolder folder;
    const auto lut = markedLattice(17, 17, 17);
    lut->outputShaper.entries.resize(1);
    Writing3DL{"flame"}(writer);
    writer.write(folder.path("out"), lut);
    return readFile(folder.path("out")).substr(0, byteCount);
}

TEST(Registry, MakesReaderAndWriterOfAnExtension) {
    for (const auto& row : kExtensions) {
        SCOPED_TRACE(row.extension);
        const std::string extension = row.extension;
        // By the file's name, and by an extension that overrules the name.
        for (const bool isGiven : {false, true}) {
            const std::string name = isGiven ? "folder/a.cube" : "no.folder/look" + extension;
            const std::string given = isGiven ? extension : ".cube";
            EXPECT_EQ(messageOf([&] { ol::createReader(name, isGiven, given)->read("/none/a"); }),
                      row.readerSays);
            std::string begin;
            const std::string message = messageOf([&] {
                const auto writer = ol::createWriter(name, isGiven, given);
                EXPECT_EQ(writer.use_count(), 1);
                begin = beginOf(*writer, std::string(row.writerBegins).size());
            });
            EXPECT_EQ(begin.empty() ? message : begin, row.writerBegins);
        }
    }
    EXPECT_EQ(messageOf([] { ol::createReader("look.cube", true, "cube"); }), kNoReader);
    EXPECT_EQ(messageOf([] { ol::createReader("look.cube", true, "look.cube"); }), kNoReader);
}

TEST(Registry, SplitsAPathAtTheLastDotOfItsName) {
    const struct {
        const char *base, *extension;
    } rows[] = {
        {"lut", ".cube"},     {"look.v2", ".cube"}, {"look.vf", ".gz"}, {"dir.old/lut", ""},
        {"dir.old\\lut", ""}, {"disk.one:lut", ""}, {".cube", ""},      {"a/b.c/look", ".csp"},
        {"dir/.cube", ""},    {"dir\\.cube", ""},   {"C:.cube", ""},    {".", ".cube"},
        {"look", "."},        {"look.cube/", ""},   {"look", ""},       {"", ""},
    };
    for (const auto& row : rows) {
        const std::string path = std::string(row.base) + row.extension;
        SCOPED_TRACE(path);
        std::string base = "old";
        std::string extension = "old";
        ol::splitExtension(path, &base, &extension);
        EXPECT_EQ(base, row.base);
        EXPECT_EQ(extension, row.extension);
        base = extension = path;  // the parts may replace the path
        ol::splitExtension(base, &base, nullptr);
        ol::splitExtension(extension, nullptr, &extension);
        EXPECT_EQ(base, row.base);
        EXPECT_EQ(extension, row.extension);
    }
}

}  // namespace
