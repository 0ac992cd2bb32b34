#include <gtest/gtest.h>

#include "tests/support/Files.h"
#include "tests/support/ForeignFiles.h"

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

TEST(CSPInterchange, ReadsFilesAsMeant) {
    const auto lattice = [](const char* from, const char* to) {
        return replaced(kLattice, from, to);
    };
    const Outcome shaped("1.5 .5 2 -> .625 .75 .6");
    const Outcome curved("1.5 .5 2 -> .5 .75 2");
    expectOutcomes(
        ".csp",
        {{"metadata", lattice("3D\n3", "3D\nBEGIN METADATA\n1 2 3\nx \\\n# y\nEND METADATA\n3"),
          kMeant, shaped},
         {"a comment that joins nothing", lattice("\n1 1 0\n", "\n# y \\\n1 1 0\n"), kMeant,
          shaped},
         {"joined", lattice("0 1 2\n", "0 \\\n1\\\n2\n"), kMeant, shaped},
         {"beyond the table", lattice("0.25 1", "0.25 2"), kMeant, "1.5 .5 2 -> 1 .75 .6",
          "11: the red shaper leads beyond 0 to 1, where the table ends"},
         {"a curve", kCurve, kMeant, curved},
         {"a curve by the book", kCurve, kBook, curved,
          "11: the shapers are not used: the curve covers 0 to 1"},
         {"a keyword", lattice("\n1 1 0", "\nA 1 0"), kMeant, kNoMore3D, "16: \"A\" is no number"},
         {"four numbers", lattice("\n1 1 0", "\n1 1 0 1"), kMeant, kNoMore3D,
          "16: a sample has three numbers, this line 4"},
         {"a side of one", lattice("2 2 2", "2 4 1"), kMeant, kNoMore3D,
          "12: a table needs at least 2 points a side"},
         {"falling positions", lattice("-1 1", "1 -1"), kMeant, kNoMore3D,
          "11: the input positions of the green shaper do not rise"},
         {"one position", lattice("2\n-1 1\n0 1", "1\n0\n0"), kMeant, kNoMore3D,
          "11: the green shaper needs at least 2 points"},
         {"another version", lattice("V100", "V200"), kBook,
          "CSP LUT reader: expecting version identifier CSPLUTV100.",
          "1: \"CSPLUTV200\" is not \"CSPLUTV100\""},
         {"a short row", lattice("0 1 2\n", "0 1\n"), kBook, kShaperError,
          "4: the line has 2 numbers, its shaper another count of points"},
         {"metadata without end", lattice("3D\n", "3D\nBEGIN METADATA\n"), kBook,
          "CSP LUT reader: expecting more pre-LUT data.", "21: \"END METADATA\" is missing"},
         {"blank by the book", replaced(kCurve, "3\n0 0 0\n", "3\n0 0 0\n\n"), kBook,
          "1.5 .5 2 -> 0 .25 1",
          "11: the shapers are not used: the curve covers 0 to 1 | 14: the blank line is taken for "
          "a sample"},
         {"cut short by the book", replaced(kCurve, "1 1 2\n", ""), kBook, kNoMore1D,
          "11: the shapers are not used: the curve covers 0 to 1 | 14: the file ends after 2 of 3 "
          "samples"}});
}

}  // namespace
