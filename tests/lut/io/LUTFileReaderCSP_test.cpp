#include "lut/io/LUTFileReaderCSP.h"

#include <gtest/gtest.h>

#include <cmath>
#include <stdexcept>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr char kNoVersion[] = "CSP LUT reader: expecting version identifier CSPLUTV100.";
constexpr char kNoKind[] = "CSP LUT reader: expecting a 1D or 3D lut.";
constexpr char kNoMoreShaper[] = "CSP LUT reader: expecting more pre-LUT data.";
constexpr char kShaperError[] =
    "CSP LUT reader: found different number of data elements than pre-LUT size specified.";
constexpr char kSizeError[] = "CSP LUT reader: syntax error while reading 3D LUT size.";
constexpr char kNoMore3D[] =
    "CSP LUT reader: syntax error while reading 3D LUT data, expecting more data.";
constexpr char kNoMore1D[] =
    "CSP LUT reader: syntax error while reading LUT data, expecting more data.";

/// A table up to its size line.
std::string upToSize(const std::string& kind) {
    return "CSPLUTV100\n" + kind + "\n2\n0 1\n0 1\n2\n0 1\n0 1\n2\n0 1\n0 1\n";
}

TEST(CSPReader, ContinuesShortShapersWithTheirLastValue) {
    const auto lut = readBytes(".csp", readFile(dataPath("csp/lattice.csp")));
    const float inputs[][3] = {
        {0.0F, -0.5F, 0.0F}, {1.0F, 0.25F, 0.1F}, {1.0F, 1.5F, 0.2F},
        {1.0F, 1.5F, 0.4F},  {1.0F, 1.5F, 0.8F},
    };
    const float outputs[][3] = {
        {0.25F, 0.1F, 0.0F}, {0.75F, 0.2F, 0.2F}, {0.75F, 0.3F, 0.5F},
        {0.75F, 0.3F, 0.7F}, {0.75F, 0.3F, 1.0F},
    };
    ASSERT_EQ(lut->inputShaper.entries.size(), 5U);
    ASSERT_EQ(lut->outputShaper.entries.size(), 5U);
    for (std::size_t i = 0; i < 5; ++i) {
        expectRGB(lut->inputShaper.entries[i], ol::RGB(inputs[i]));
        expectRGB(lut->outputShaper.entries[i], ol::RGB(outputs[i]));
    }
    expectRGB(lut->inputShaper.counts, 2.0F, 3.0F, 5.0F);
    expectRGB(lut->outputShaper.counts, 2.0F, 3.0F, 5.0F);
}

TEST(CSPReader, ReadsACurveAndNothingAfterItsLastEntry) {
    const auto lut = readBytes(
        ".csp", "  CSPLUTV100 \r" + readFile(dataPath("csp/curve.csp")).substr(10) + "x\n");
    ASSERT_TRUE(lut->is1D());
    ASSERT_EQ(lut->width(), 3);
    expectRGB(lut->get(1), 0.5F, 0.25F, 0.75F);
    EXPECT_EQ(lut->transform[0][0], 0.5F);
    EXPECT_EQ(lut->transform[2][2], 0.5F);
}

TEST(CSPReader, TakesEveryLineForASample) {
    const struct {
        const char* line;
        float rgb[3];
    } cases[] = {
        {"", {0.0F, 0.0F, 0.0F}},
        {" \t", {0.0F, 0.0F, 0.0F}},
        {"1", {1.0F, 0.0F, 0.0F}},
        {"1 2", {1.0F, 2.0F, 0.0F}},
        {"1 2 3 4 x", {1.0F, 2.0F, 3.0F}},
        {"# 5 6", {0.0F, 5.0F, 6.0F}},
        {"+1e1 0x10 a\r", {10.0F, 16.0F, 0.0F}},
    };
    for (const auto& [line, rgb] : cases) {
        SCOPED_TRACE(line);
        const auto lut = readBytes(".csp", upToSize("1D") + "2\n" + line + "\n7 8 9\n");
        expectRGB(lut->get(0), ol::RGB(rgb));
        expectRGB(lut->get(1), 7.0F, 8.0F, 9.0F);
    }
}

TEST(CSPReader, JoinsALineThatEndsInABackslashOnce) {
    const std::string rows = replaced(upToSize("1D"), "2\n0 1\n", "3\n0 \\ \n 1\\\n");
    const auto shaper = readBytes(".csp", replaced(rows, "0 1\n", "3 4\\\n5\n") + "0\n");
    expectRGB(shaper->inputShaper.entries[1], 0.0F, 1.0F, 1.0F);  // the lone backslash is a word
    EXPECT_EQ(shaper->inputShaper.entries[2][0], 1.0F);
    EXPECT_EQ(shaper->outputShaper.entries[1][0], 4.0F);
    EXPECT_EQ(shaper->outputShaper.entries[2][0], 5.0F);

    const auto samples = readBytes(".csp", upToSize("1D") + "2\n1 2\\\r\n3\\\n4 5 \\\n6\n");
    expectRGB(samples->get(0), 1.0F, 2.0F, 3.0F);
    expectRGB(samples->get(1), 4.0F, 5.0F, 0.0F);
    EXPECT_EQ(messageOf([] { readBytes(".csp", upToSize("1D") + "1\n1 2 3\\"); }), kNoMore1D);
}

TEST(CSPReader, RefusesWhatIsNoTable) {
    expectRefused(".csp", readFile(dataPath("csp/lattice.csp")),
                  {{"text after the version", "V100", "V100 x", kNoVersion},
                   {"another version", "V100", "V200", kNoVersion},
                   {"another kind", "3D\n", "2D\n", kNoKind},
                   {"kind missing", "3D\n", "\n", kNoKind},
                   {"metadata without end", "END METADATA\nEND METADATA", "END", kNoMoreShaper},
                   {"end of metadata joined away", "\nEND", "\\\nEND", kNoMoreShaper},
                   {"row too long", "0.25 0.75", "0.25 0.75 1", kShaperError},
                   {"row too short", "-0.5 0.25 1.5", "-0.5 1.5", kShaperError},
                   {"count of zero", "\n3\n", "\n0\n", kShaperError},
                   {"count below zero", "\n3\n", "\n-3\n", kShaperError},
                   {"count that no row has", "\n3\n", "\n2147483647\n", kShaperError},
                   {"two sizes", "2 3 4", "2 3", kSizeError},
                   {"comment before the size", "2 3 4", "# size\n2 3 4", kSizeError}});
    expectRefused(".csp", readFile(dataPath("csp/curve.csp")),
                  {{"comment before the first count", "1D\n", "1D\n# red\n", kShaperError},
                   {"one line missing", "0 0 0\n", "", kNoMore1D}});
    EXPECT_EQ(messageOf([] { readBytes(".csp", upToSize("3D") + "\n\n"); }), kSizeError);
    EXPECT_EQ(messageOf([] { readBytes(".csp", upToSize("1D") + "\n\n"); }), kNoMore1D);
}

TEST(CSPReader, BelievesNoSize) {
    EXPECT_THROW(readBytes(".csp", upToSize("3D") + "2 -2 2\n"), std::length_error);
    EXPECT_THROW(readBytes(".csp", upToSize("1D") + "-1\n"), std::length_error);
    const auto flat = readBytes(".csp", upToSize("3D") + "2 1 1\n1 1 1\n2 2 2\n");
    EXPECT_TRUE(std::isinf(flat->transform[1][1]));
}

}  // namespace
