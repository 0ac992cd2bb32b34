#include <gtest/gtest.h>

#include <algorithm>

#include "tests/support/Files.h"
#include "tests/support/ForeignFiles.h"

namespace {

using namespace test;

// Sample i, counted in bits, is (bit 0, bit 1 / 2, bit 2 / 4).
const std::string kSamples = "0 0 0\n1 0 0\n0 .5 0\n1 .5 0\n0 0 .25\n1 0 .25\n0 .5 .25\n1 .5 .25\n";

const Outcome kRedFastest(".25 .5 1 -> .25 .25 .25");
const Outcome kBlueFastest(".25 .5 1 -> 1 .25 .0625");

/// What stands above the samples, what they are, and how the format refuses others.
struct Format {
    const char* extension;
    std::string header;
    Outcome outcome;
    const char* message;
};

const Format kFormats[] = {
    {".cube", "LUT_3D_SIZE 2\n", kRedFastest,
     "Iridas LUT reader: syntax error while reading LUT data."},
    {".cms", "LUT_3D_SIZE 2\n", kRedFastest,
     "CMS LUT reader: syntax error while reading LUT data."},
    {".csp", "CSPLUTV100\n3D\n2\n0 1\n0 1\n2\n0 1\n0 1\n2\n0 1\n0 1\n2 2 2\n", kRedFastest,
     "CSP LUT reader: syntax error while reading 3D LUT data, expecting more data."},
    {".cub", "# width 2 2 2\n", kRedFastest,
     "Truelight LUT reader: syntax error while reading LUT data (too many or not enough values)."},
    {".3dl", "0.0 1.0\n", kBlueFastest, "3DL file reader: syntax error while reading LUT data"},
    {".vf",
     "#Inventor V2.1 ascii\nField {\nparameters\ngrid_size 2 2 2\nworld_origin 0 0 0\ndata\n",
     kBlueFastest, "VF file reader: syntax error while reading LUT data."},
};

TEST(TextInterchange, ForgivesWhatDoesNoHarmInEveryFormat) {
    for (const auto& [extension, header, outcome, message] : kFormats) {
        const std::string text = header + kSamples;
        const auto with = [&](const char* from, const char* to) {
            return replaced(text, from, to);
        };
        expectOutcomes(
            extension,
            {{"as it is", text, kMeant, outcome},
             {"a mark", "\xef\xbb\xbf" + text, kMeant, outcome},
             {"returns", withReturns(text), kMeant, outcome},
             {"blanks", with("\n1 0 0\n", "\n\n \t\n 1\t0 0 \n"), kMeant, outcome},
             {"comments", with("\n1 0 0\n", "\n#x\n# y z\n1 0 0 # red\n"), kMeant, outcome},
             {"commas", with("\n0 .5 0\n", "\n-0,0 +0,5 0\n"), kMeant, outcome}});
    }
}

TEST(TextInterchange, SaysWhyDataAreRefusedInEveryFormat) {
    const struct {
        const char* name;
        const char* from;
        const char* to;
        int line;  // below the header
        const char* reason;
    } kinds[] = {
        {"a letter in a number", "\n1 0 0\n", "\n1 0.5O 0\n", 2, "\"0.5O\" is no number"},
        {"hexadecimal", "\n1 0 0\n", "\n0x1 0 0\n", 2, "\"0x1\" is no number"},
        {"two commas", "\n1 0 0\n", "\n1 0,0,0 0\n", 2, "\"0,0,0\" is no number"},
        {"not finite", "\n1 0 0\n", "\n1 nan 0\n", 2, "\"nan\" is not finite"},
        {"too large", "\n1 0 0\n", "\n1 1e39 0\n", 2, "\"1e39\" is not finite"},
        {"cut short", "\n1 .5 .25\n", "\n", 7, "the file ends after 7 of 8 samples"},
        {"a sample more", "\n1 .5 .25\n", "\n1 .5 .25\n0 0 0\n", 9,
         "there are more samples than the 8 of the table"},
    };
    for (const auto& [extension, header, outcome, message] : kFormats) {
        const auto headerLines = std::count(header.begin(), header.end(), '\n');
        for (const auto& kind : kinds) {
            const std::string text = replaced(header + kSamples, kind.from, kind.to);
            const std::string line = std::to_string(headerLines + kind.line);
            expectOutcomes(extension,
                           {{kind.name, text, kMeant, message, line + ": " + kind.reason}});
        }
    }
}

TEST(TextInterchange, SaysWhyTheBookRefusesWhatIsForgivenAsMeant) {
    constexpr char kNoTable[] = "Iridas LUT reader: LUT failed to initialise.";
    const auto& [extension, header, outcome, message] = kFormats[0];
    const std::string text = header + kSamples;
    expectOutcomes(extension, {{"a comment", "#title\n" + text, kBook, kNoTable,
                                "1: the line begins with \"#title\" and is taken for data"},
                               {"a return", "\r\n" + text, kBook, kNoTable,
                                "1: the line holds only a carriage return"},
                               {"a mark", "\xef\xbb\xbf" + text, kBook, kNoTable,
                                "1: the file begins with a byte order mark"},
                               {"four words", header + "0 0 0 0\n", kBook, message,
                                "2: the line has 4 words: \"0 0 0 0\""}});
    expectOutcomes(".csp", {{"returns alone", "CSPLUTV100\r3D\r", kBook,
                             "CSP LUT reader: expecting version identifier CSPLUTV100.",
                             "1: the lines of the file end in carriage returns alone"}});
}

}  // namespace
