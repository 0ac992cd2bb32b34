#include "lut/io/Registry.h"

#include <gtest/gtest.h>

#include "lut/io/LUTFileReader3DL.h"
#include "lut/io/LUTFileReaderBLUT.h"
#include "lut/io/LUTFileReaderCMS.h"
#include "lut/io/LUTFileReaderCSP.h"
#include "lut/io/LUTFileReaderIridas.h"
#include "lut/io/LUTFileReaderTruelight.h"
#include "lut/io/LUTFileReaderVF.h"
#include "lut/io/LUTFileWriter3DL.h"
#include "lut/io/LUTFileWriterBLUT.h"
#include "lut/io/LUTFileWriterCMS.h"
#include "lut/io/LUTFileWriterCSP.h"
#include "lut/io/LUTFileWriterIridas.h"
#include "lut/io/LUTFileWriterTruelight.h"
#include "lut/io/LUTFileWriterVF.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

template <class Face, class Format>
bool isA(const Face& face) {
    return dynamic_cast<const Format*>(&face) != nullptr;
}

/// What an extension gives: one class, or a message.
template <class Face>
struct Row {
    const char* extension;
    bool (*isExpected)(const Face&);
    const char* message = "(no exception)";
};

template <class Format>
constexpr Row<ol::LUTFileReader> reads(const char* extension) {
    return {extension, isA<ol::LUTFileReader, Format>};
}

template <class Format>
constexpr Row<ol::LUTFileWriter> writes(const char* extension) {
    return {extension, isA<ol::LUTFileWriter, Format>};
}

constexpr char kNoReader[] = "No reader found for extension \"%s\".";
constexpr char kNoWriter[] = "No writer found for extension \"%s\".";

constexpr Row<ol::LUTFileReader> kReaders[] = {
    reads<ol::LUTFileReaderIridas>(".cube"),
    reads<ol::LUTFileReaderIridas>(".itx"),
    reads<ol::LUTFileReaderTruelight>(".cub"),
    reads<ol::LUTFileReader3DL>(".3dl"),
    reads<ol::LUTFileReaderVF>(".vf"),
    reads<ol::LUTFileReaderVF>(".gz"),
    reads<ol::LUTFileReaderVF>(".vfz"),
    reads<ol::LUTFileReaderCSP>(".csp"),
    reads<ol::LUTFileReaderCMS>(".cms"),
    reads<ol::LUTFileReaderBLUT>(".blut"),
    {".icc", nullptr, "reader not found"},
    {".CUBE", nullptr, kNoReader},
    {".cubes", nullptr, kNoReader},
    {".tiff", nullptr, kNoReader},
    {"", nullptr, kNoReader},
};

constexpr Row<ol::LUTFileWriter> kWriters[] = {
    writes<ol::LUTFileWriterIridas>(".cube"),
    writes<ol::LUTFileWriter3DL>(".3dl"),
    writes<ol::LUTFileWriterVF>(".vf"),
    writes<ol::LUTFileWriterVF>(".gz"),
    writes<ol::LUTFileWriterVF>(".vfz"),
    writes<ol::LUTFileWriterCSP>(".csp"),
    writes<ol::LUTFileWriterTruelight>(".cub"),
    writes<ol::LUTFileWriterCMS>(".cms"),
    writes<ol::LUTFileWriterBLUT>(".blut"),
    {".itx", nullptr, kNoWriter},
    {".icc", nullptr, "writer not found"},
    {".CUBE", nullptr, kNoWriter},
    {".tiff", nullptr, kNoWriter},
    {"", nullptr, kNoWriter},
};

/// Asks for every row twice: by the file's name, and by an extension that overrules the name.
template <class Face, std::size_t kRowCount, class Create>
void expectRows(const Row<Face> (&rows)[kRowCount], Create create) {
    for (const Row<Face>& row : rows) {
        SCOPED_TRACE(row.extension);
        const std::string extension = row.extension;
        for (const bool isGiven : {false, true}) {
            boost::shared_ptr<Face> made;
            EXPECT_EQ(messageOf([&] {
                          made = isGiven ? create("folder/look.cube", true, extension)
                                         : create("no.folder/look" + extension, false, ".cube");
                      }),
                      row.message);
            if (row.isExpected == nullptr) continue;
            ASSERT_TRUE(made);
            EXPECT_TRUE(row.isExpected(*made));
            EXPECT_EQ(made.use_count(), 1);
        }
    }
}

TEST(Registry, MakesTheReaderOfAnExtension) {
    expectRows(kReaders, ol::createReader);
}

TEST(Registry, MakesTheWriterOfAnExtension) {
    expectRows(kWriters, ol::createWriter);
}

TEST(Registry, TakesAGivenExtensionAsItStands) {
    EXPECT_EQ(messageOf([] { ol::createReader("look.cube", true, "cube"); }), kNoReader);
    EXPECT_EQ(messageOf([] { ol::createReader("look.cube", true, "look.cube"); }), kNoReader);
    EXPECT_EQ(messageOf([] { ol::createWriter("out", false, ".cube"); }), kNoWriter);
    EXPECT_TRUE(ol::createWriter("out", true, ".cube"));
}

TEST(Registry, SplitsAPathAtTheLastDotOfItsName) {
    const struct {
        const char* path;
        const char* base;
        const char* extension;
    } rows[] = {
        {"lut.cube", "lut", ".cube"},
        {"look.v2.cube", "look.v2", ".cube"},
        {"look.vf.gz", "look.vf", ".gz"},
        {"dir.old/lut", "dir.old/lut", ""},
        {"dir.old\\lut", "dir.old\\lut", ""},
        {"disk.one:lut", "disk.one:lut", ""},
        {"a/b.c/look.csp", "a/b.c/look", ".csp"},
        {".cube", ".cube", ""},
        {"dir/.cube", "dir/.cube", ""},
        {"dir\\.cube", "dir\\.cube", ""},
        {"C:.cube", "C:.cube", ""},
        {"..cube", ".", ".cube"},
        {"look.", "look", "."},
        {"look.cube/", "look.cube/", ""},
        {"look", "look", ""},
        {"", "", ""},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.path);
        std::string base = "old";
        std::string extension = "old";
        ol::splitExtension(row.path, &base, &extension);
        EXPECT_EQ(base, row.base);
        EXPECT_EQ(extension, row.extension);

        std::string path = row.path;  // the parts may replace the path
        ol::splitExtension(path, &path, nullptr);
        EXPECT_EQ(path, row.base);
        path = row.path;
        ol::splitExtension(path, nullptr, &path);
        EXPECT_EQ(path, row.extension);
    }
}

TEST(FileInterfaces, KeepTheFirstPropertyOfAName) {
    namespace property = Orlith::Property;
    const auto reader = ol::createReader("look.cube", false, "");
    EXPECT_FALSE(reader->getProperty("bits"));
    EXPECT_TRUE(reader->setProperty("bits", property::makeProperty<property::Int>("bits", 10)));
    EXPECT_FALSE(reader->setProperty("bits", property::makeProperty<property::Int>("bits", 12)));
    EXPECT_EQ(reader->getProperty("bits")->toString(), "10");
    const auto writer = ol::createWriter("look.cube", false, "");
    EXPECT_TRUE(writer->setProperty("bits", property::makeProperty<property::Int>("bits", 10)));
    EXPECT_FALSE(writer->setProperty("bits", property::makeProperty<property::Int>("bits", 12)));
}

}  // namespace
