// What writers have in common: their bytes, reading them back, and what they refuse. What a format
// has for itself is in the file of its writer.

#include <gtest/gtest.h>

#include <filesystem>
#include <optional>

#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/GermanLocale.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

/// A marked lattice, with a pre-LUT of which no two numbers are the same.
boost::shared_ptr<ol::LUT3D> withPreLUT(int width, int height, int depth) {
    auto lut = markedLattice(width, height, depth);
    lut->outputShaper.entries = {{0.0F, 0.0F, 0.0F}, {0.25F, 0.5F, 1.0F}, {2.0F, 3.0F, 4.0F}};
    return lut;
}

/// Entries whose floats count from `first` in storage order.
std::vector<ol::RGB> counting(int entryCount, int first) {
    std::vector<ol::RGB> entries;
    for (int i = 0; i < entryCount; ++i) {
        const auto number = static_cast<float>(first + 3 * i);
        entries.emplace_back(number, number + 1.0F, number + 2.0F);
    }
    return entries;
}

boost::shared_ptr<ol::LUT1D> curveWithShapers(int inputCount, int outputCount) {
    auto lut = markedCurve(1);
    lut->inputShaper.entries = counting(inputCount, 0);
    lut->outputShaper.entries = counting(outputCount, 100);
    return lut;
}

struct WrittenFile {
    const char* name;  // under tests/data; its extension chooses the writer
    boost::shared_ptr<ol::LUT> lut;
    Writing3DL writing = {"flame"};
};

// In every locale, line by line or in blocks, over a longer file.
TEST(TextWriter, WritesTheseBytes) {
    const auto codes = markedLattice(2, 2, 2, 4095.0F);
    const auto inputLUT = markedLattice(2, 1, 3);
    inputLUT->outputShaper.entries = {{0.0F, -0.25F, 0.5F}, {1.0F, 2.0F, 1000.0F}};
    inputLUT->inputShaper.entries = counting(1, 9);  // of no use
    const auto noEntries = markedLattice(1, 2, 2);
    noEntries->outputShaper.counts.fill(2.0F);  // counts without entries are no shaper
    const auto halfShaped = markedLattice(2, 1, 3);
    halfShaped->outputShaper.entries = counting(2, 0);  // of no use without the other
    const WrittenFile files[] = {
        {"3dl/flame.3dl", codes},
        {"3dl/written-lustre.3dl", codes, {"lustre"}},
        {"3dl/written-scratch.3dl", codes, {"scratch", 12}},
        {"cms/written.cms", withPreLUT(2, 2, 2)},
        {"csp/written.csp", halfShaped},
        {"csp/written-shapers.csp", curveWithShapers(4, 5)},
        {"cub/written-input-lut.cub", inputLUT},
        {"cub/written.cub", noEntries},
        {"cube/written.cube", markedLattice(2, 2, 2)},
        {"cube/written-curve.cube", markedCurve(3)},
        {"vf/written.vf", markedLattice(2, 2, 2)},
    };
    testing::internal::CaptureStderr();
    for (const auto& [name, lut, writing] : files) {
        SCOPED_TRACE(name);
        const TempFolder folder;
        const std::string path = folder.write("old", std::string(100000, 'x'));
        for (const int flushes : {0, 1}) {
            std::optional<GermanLocale> locale;
            if (flushes == 0) locale.emplace();
            const auto writer = ol::createWriter(name, false, "");
            writing(*writer);
            setProperty<Orlith::Property::Int>(*writer, "flushLines", flushes);
            writer->write(path, lut);
            EXPECT_EQ(readFile(path), readFile(dataPath(name)));
        }
    }
    testing::internal::GetCapturedStderr();
}

TEST(EveryWriter, RefusesBeforeAFileIsMade) {
    using LUTs = std::vector<boost::shared_ptr<ol::LUT>>;
    const LUTs curve = {markedCurve(2)};
    const LUTs boxes = {withPreLUT(2, 2, 3), withPreLUT(2, 3, 2), withPreLUT(3, 2, 2)};
    constexpr char kLattice[] = "unable to write: must be a 3D lut";
    constexpr char kCube[] = "unable to write: must have the same dimension in r, g and b";
    const struct {
        const char* extension;
        LUTs luts;
        const char* message;
    } rows[] = {
        {".3dl", curve, kLattice},
        {".3dl", boxes, "unable to write: cube size must be identical in r, g and b"},
        {".3dl", {markedLattice(1, 1, 1)}, "unable to write: cube size must be at least 2"},
        {".3dl", {markedLattice(66, 66, 66)}, "unable to write: cube size may be at most 65"},
        {".blut", curve, "height: not available"},
        {".blut", boxes, kCube},
        {".cms", curve, kLattice},
        {".cms", boxes, kCube},
        {".cms", {markedLattice(2, 2, 3)}, "unable to write: expecting pre-LUT data"},
        {".csp",
         {curveWithShapers(1, 1), curveWithShapers(2, 9), curveWithShapers(4, 3)},
         "unable to write: pre-LUT needs at least three entries in both shapers"},
        {".cub", curve, kLattice},
        {".cube", boxes, kCube},
        {".vf", curve, kLattice},
        {".vf", boxes, kCube},
    };
    const TempFolder folder;
    testing::internal::CaptureStderr();
    for (const auto& row : rows) {
        SCOPED_TRACE(row.extension);
        const auto writer = ol::createWriter("", true, row.extension);
        Writing3DL{"flame"}(*writer);
        for (const auto& lut : row.luts)
            EXPECT_EQ(messageOf([&] { writer->write(folder.path("no"), lut); }), row.message);
        EXPECT_FALSE(std::filesystem::exists(folder.path("no")));
        EXPECT_EQ(messageOf([&] { writer->write(folder.path("no/no"), withPreLUT(2, 2, 2)); }),
                  "unable to open file for writing");
    }
    testing::internal::GetCapturedStderr();
}

}  // namespace
