#include <gtest/gtest.h>

#include <functional>

#include "lut/io/LUTFileReaderCSP.h"
#include "lut/io/LUTFileWriterCSP.h"
#include "tests/support/Files.h"
#include "tests/support/Meant.h"
#include "tests/support/ThreeDL.h"

namespace {

using namespace test;

constexpr char kShaperError[] =
    "CSP LUT reader: found different number of data elements than pre-LUT size specified.";
constexpr char kNoMore3D[] =
    "CSP LUT reader: syntax error while reading 3D LUT data, expecting more data.";
constexpr char kNoMore1D[] =
    "CSP LUT reader: syntax error while reading LUT data, expecting more data.";

// Three shapers, each of its own, before a lattice that gives back its positions.
constexpr char kLattice[] =
    "CSPLUTV100\n3D\n3\n0 1 2\n0 0.25 1\n2\n-1 1\n0 1\n4\n0 1 1 4\n0 0.2 0.4 1\n2 2 2\n"
    "0 0 0\n1 0 0\n0 1 0\n1 1 0\n0 0 1\n1 0 1\n0 1 1\n1 1 1\n";
constexpr char kCurve[] =
    "CSPLUTV100\n1D\n2\n0 2\n0 1\n2\n-1 1\n0 1\n2\n0 1\n0 1\n3\n0 0 0\n0 0.5 1\n1 1 2\n";
const ol::RGB kInput(1.5F, 0.5F, 2.0F);
const ol::RGB kOutput(0.625F, 0.75F, 0.6F);

TEST(CSPInterchange, ReadsFilesAsMeant) {
    const auto lattice = [](const char* from, const char* to) {
        return replaced(kLattice, from, to);
    };
    const std::string metadata = "3D\nBEGIN METADATA\n1 2 3\nx \\\n# y\nEND METADATA\n3\n0 1 2";
    const ol::RGB none(0.0F, 0.0F, 0.0F);
    expectMeant(
        ".csp", kInput,
        {{"as it is", kLattice, true, "", kOutput, ""},
         {"metadata", lattice("3D\n3\n0 1 2", metadata.c_str()), true, "", kOutput, ""},
         {"mark, carriage returns", "\xef\xbb\xbf" + lattice("3D\n", "\r\n3D\r\n"), true, "",
          kOutput, ""},
         {"between samples", lattice("\n1 1 0\n", "\n \r\n#x\n1 1 0\n# y \\\n"), true, "", kOutput,
          ""},
         {"joined", lattice("0 1 2\n", "0 \\\n1\\\n2\n"), true, "", kOutput, ""},
         {"decimal comma", lattice("0.25", "0,25"), true, "", kOutput, ""},
         {"beyond the table", lattice("0.25 1", "0.25 2"), true, "", ol::RGB(1.0F, 0.75F, 0.6F),
          "the red shaper leads beyond 0 to 1, where the table ends"},
         {"a curve", kCurve, true, "", ol::RGB(0.5F, 0.75F, 2.0F), ""},
         {"a curve by the book", kCurve, false, "", ol::RGB(0.5F, 0.75F, 2.0F),
          "the shapers are not used: the curve covers 0 to 1"},
         {"a word", lattice("\n1 1 0", "\n1 O 0"), true, kNoMore3D, none, "\"O\" is no number"},
         {"a keyword", lattice("\n1 1 0", "\nA 1 0"), true, kNoMore3D, none, "\"A\" is no number"},
         {"not finite", lattice("\n1 1 0", "\nnan 1 0"), true, kNoMore3D, none,
          "\"nan\" is not finite"},
         {"four numbers", lattice("\n1 1 0", "\n1 1 0 1"), true, kNoMore3D, none,
          "a sample has three numbers, this line 4"},
         {"cut short", lattice("\n1 1 1", ""), true, kNoMore3D, none,
          "the file ends after 7 of 8 samples"},
         {"too long", kLattice + std::string("1 1 1\n"), true, kNoMore3D, none,
          "there are more samples than the 8 of the table"},
         {"a side of one", lattice("2 2 2", "2 4 1"), true, kNoMore3D, none,
          "a table needs at least 2 points a side"},
         {"falling positions", lattice("-1 1", "1 -1"), true, kNoMore3D, none,
          "the input positions of the green shaper do not rise"},
         {"one position", lattice("2\n-1 1\n0 1", "1\n0\n0"), true, kNoMore3D, none,
          "the green shaper needs at least 2 points"},
         {"another version", lattice("V100", "V200"), false,
          "CSP LUT reader: expecting version identifier CSPLUTV100.", none,
          "\"CSPLUTV200\" is not \"CSPLUTV100\""},
         {"a short row", lattice("0 1 2\n", "0 1\n"), false, kShaperError, none,
          "the line has 2 numbers, its shaper another count of points"},
         {"metadata without end", lattice("3D\n", "3D\nBEGIN METADATA\n"), false,
          "CSP LUT reader: expecting more pre-LUT data.", none, "\"END METADATA\" is missing"},
         {"blank by the book", replaced(kCurve, "3\n0 0 0\n", "3\n0 0 0\n\n"), false, "",
          ol::RGB(0.0F, 0.25F, 1.0F), "the blank line is taken for a sample"},
         {"cut short by the book", replaced(kCurve, "1 1 2\n", ""), false, kNoMore1D, none,
          "the file ends after 2 of 3 samples"}});
}

/// A lattice or a curve that gives back the place among its points, in quarters, on each channel.
boost::shared_ptr<ol::LUT> identity(bool isCurve) {
    boost::shared_ptr<ol::LUT> lut;
    if (isCurve) {
        lut = markedCurve(5);
        for (int i = 0; i < 5; ++i)
            lut->get(i).fill(static_cast<float>(i) / 4.0F);
        ol::setUnitDomain(*lut, 5, 5, 5);
        return lut;
    }
    lut = markedLattice(3, 4, 2);
    for (int b = 0; b < 2; ++b) {
        for (int g = 0; g < 4; ++g) {
            for (int r = 0; r < 3; ++r) {
                const ol::RGB place(static_cast<float>(r), static_cast<float>(g),
                                    static_cast<float>(b));
                lut->get(r, g, b) = place / 4.0F;
            }
        }
    }
    ol::setUnitDomain(*lut, 3, 4, 2);
    return lut;
}

/// A shaper of three channels with their own points.
ol::Shaper shaper(const ol::RGB& counts, const std::vector<ol::RGB>& entries) {
    ol::Shaper result;
    result.entries = entries;
    result.counts = counts;
    return result;
}

TEST(CSPInterchange, WritesTheLookOfEveryTable) {
    const auto setDomain = [](ol::LUT& lut) {
        for (unsigned c = 0; c < 3; ++c) {
            lut.transform[c][c] = 0.25F + static_cast<float>(c);
            lut.transform[3][c] = -0.5F;
        }
    };
    const auto setInput = [](ol::LUT& lut) {
        lut.inputShaper = shaper(
            {2.0F, 3.0F, 3.0F}, {{-1.0F, 0.0F, 0.0F}, {2.0F, 0.75F, 0.0F}, {9.0F, 1.0F, 65504.0F}});
    };
    const auto setOutput = [](ol::LUT& lut) {
        lut.outputShaper = shaper(
            {4.0F, 2.0F, 4.0F},
            {{0.0F, 1.0F, -0.25F}, {0.5F, 0.0F, 0.25F}, {0.625F, 0.0F, 0.5F}, {1.0F, 0.0F, 1.5F}});
    };
    const struct {
        const char* name;
        std::vector<std::function<void(ol::LUT&)>> steps;
    } cases[] = {
        {"plain", {}},
        {"domain", {setDomain}},
        {"input shaper", {setInput}},
        {"output shaper", {setOutput}},
        {"both shapers", {setInput, setOutput}},
        {"all of them", {setDomain, setInput, setOutput}},
    };
    const TempFolder folder;
    const std::string file = folder.path("look.csp");
    for (const auto& [name, steps] : cases) {
        for (const bool isCurve : {false, true}) {
            SCOPED_TRACE(std::string(name) + (isCurve ? ", curve" : ", lattice"));
            const auto lut = identity(isCurve);
            for (const auto& step : steps)
                step(*lut);
            ol::LUTFileWriterCSP writer;
            setProperty<Orlith::Property::Int>(writer, "interchange", 1);
            writer.write(file, lut);
            ol::LUTFileReaderCSP reader;
            setProperty<Orlith::Property::Int>(reader, "interchange", 1);
            const auto read = reader.read(file);
            for (int i = 0; i <= 40; ++i) {
                // Below, within and above every domain; blue reaches far.
                const float t = static_cast<float>(i) / 8.0F - 1.5F;
                for (const ol::RGB& input : {ol::RGB(t, t, t), ol::RGB(2.0F - t, t, t * 9000.0F)}) {
                    const ol::RGB expected = evaluated(lut, input);
                    const ol::RGB actual = evaluated(read, input);
                    for (unsigned c = 0; c < 3; ++c)
                        ASSERT_NEAR(actual[c], expected[c], 2e-6F) << input << " channel " << c;
                }
            }
        }
    }
    EXPECT_NE(readFile(file).find("65504.000000"), std::string::npos);
}

TEST(CSPInterchange, RefusesToWriteInputsThatDoNotRise) {
    const auto lut = markedLattice(2, 2, 2);
    lut->transform[1][1] = -1.0F;
    ol::LUTFileWriterCSP writer;
    setProperty<Orlith::Property::Int>(writer, "interchange", 1);
    EXPECT_EQ(messageOf([&] { writer.write("/no/such/folder/look.csp", lut); }),
              "unable to write: the inputs of the table do not rise");
}

}  // namespace
