// The commands that look at tables: info, eval and diff.

#include "tests/orlith/Program.h"

namespace {

// Red and green swapped, blue bent: off the identity by at most 1.
constexpr char kLattice[] =
    "LUT_3D_SIZE 2\n"
    "0 0 0.5\n0 1 0.5\n1 0 0.5\n1 1 0.5\n"
    "0 0 0.25\n0 1 0.25\n1 0 0.25\n1 1 0.25\n";

using InspectTest = test::ProgramTest;

TEST_F(InspectTest, InfoTellsAPersonWhatIsInAFile) {
    folder_.write("lattice.cube", kLattice);
    EXPECT_EQ(output("info lattice.cube"),
              "file            lattice.cube\n"
              "format          .cube\n"
              "table           3D, 2 x 2 x 2 points\n"
              "samples read    8\n"
              "domain          0 0 0 to 1 1 1\n"
              "range           0 0 0.25 to 1 1 0.5\n"
              "from identity   1 at most\n"
              "monotone        red yes, green yes, blue yes\n"
              "faults          neutrals lean to yellow by 0.75 at most, at 1 1 1\n");
    folder_.write("curve", "LUT_1D_SIZE 3\n0 1 nan\n0 0.25 nan\n1 0.5 nan\n");
    EXPECT_EQ(output("info curve --from cube --values --strict"),
              "file            curve\n"
              "format          .cube\n"
              "table           1D, 3 entries\n"
              "samples read    3\n"
              "domain          0 0 0 to 1 1 1\n"
              "range           0 0.25 nan to 1 1 nan\n"
              "from identity   inf at most\n"
              "monotone        red yes, green no, blue no\n"
              "faults          3 samples are not finite, the first at 0 0 0\n"
              "                green folds back by 0.25 from 0.5 0.5 0.5 to 1 1 1\n"
              "0 1 nan\n"
              "0 0.25 nan\n"
              "1 0.5 nan\n");
}

TEST_F(InspectTest, InfoPrintsOneJsonObject) {
    // A name with a quote, a backslash, a line end, a letter of two bytes and a byte that is none.
    const std::string name = "a\"\\\n\xc3\xa9\xff.csp";
    folder_.write(name,
                  "CSPLUTV100\n3D\n\n2\n0 1\n0 0.5\n3\n0 0.25 1\n0 1e-7 1\n2\n-inf 1\n0 nan\n\n"
                  "1 1 2\n0.1 0.2 0.3\n-nan inf 16777216\n");
    EXPECT_EQ(
        output("info --json --values --strict " + name),
        "{\"file\": \"a\\\"\\\\\\n\xc3\xa9\xef\xbf\xbd.csp\", \"format\": \".csp\", \"kind\": "
        "\"3D\", \"size\": [1, 1, 2],\n"
        " \"samples_read\": 2,\n"
        " \"transform\": [[\"inf\", 0, 0, 0], [0, \"inf\", 0, 0], [0, 0, 1, 0], [0, 0, 0, 1]],"
        " \"domain\": {\"min\": [0, 0, 0], \"max\": [\"nan\", \"nan\", 1]},\n"
        " \"inputShaper\": {\"counts\": [2, 3, 2], \"entries\": [[0, 0, \"-inf\"], [1, 0.25,"
        " 1], [1, 1, 1]]}, \"outputShaper\": {\"counts\": [2, 3, 2], \"entries\": [[0, 0, 0],"
        " [0.5, 1e-07, \"nan\"], [0.5, 1, \"nan\"]]},\n"
        " \"range\": {\"min\": [0.1, 0.2, 0.3], \"max\": [0.1, \"inf\", 16777216]},\n"
        " \"faults\": [{\"kind\": \"not finite\", \"channels\": [\"red\", \"green\"], "
        "\"from\": [0, 0, \"nan\"], \"to\": [0, 0, \"nan\"], \"amount\": \"inf\", "
        "\"count\": 1, \"text\": \"1 sample is not finite, at 0 0 nan\"}],\n"
        " \"remarks\": [],\n"
        " \"values\": [[0.1, 0.2, 0.3], [\"nan\", \"inf\", 16777216]]}\n");
}

TEST_F(InspectTest, TinyFilesWithHugeClaimsAreAnsweredAtOnce) {
    folder_.write("claim.cube", "LUT_3D_SIZE 400\n0 0 0\n");
    folder_.write("surplus.cub", "# width 1 1 1\n0 0 0\n1 1 1\n");
#define REASON                                                                                   \
    "claim.cube:2: Iridas LUT reader: syntax error while reading LUT data. (the file ends after" \
    " 1 of 64000000 samples)\n"
    const test::Outcome json = run("info claim.cube --json");
    EXPECT_EQ(json.status, 0);
    EXPECT_EQ(json.err, "orlith: warning: " REASON);
    test::expectIn(json.out, "\"samples_read\": 1,\n");
    test::expectIn(json.out, "\"range\": null,\n \"faults\": null,\n");
    expectAll({
        {"info claim.cube --values", 1, "",
         "orlith: warning: " REASON
         "orlith: error: claim.cube: 64000000 points are too many for --values (at most"
         " 16777216)\n"},
        {"eval claim.cube 1 1 1 --strict", 0, "0 0 0\n",
         "orlith: warning: claim.cube: holds 1 samples, its table has 64000000 points\n"},
        {"eval claim.cube 1 1 1", 1, "", "orlith: error: " REASON},
        {"diff claim.cube surplus.cub --strict", 1, "",
         "orlith: error: claim.cube: holds 1 samples, its table has 64000000 points\n"},
        {"eval surplus.cub 0 0 0 --strict", 0, "1 1 1\n",
         "orlith: warning: surplus.cub: holds 2 samples, its table has 1 points\n"},
    });
}

TEST_F(InspectTest, InfoReadsA3dlFileAsItIsTold) {
    folder_.write("a.3dl",
                  "0 255 \n0 0 0\n0 0 300\n0 255 0\n0 0 0\n0 0 0\n0 0 0\n0 0 0\n255 0 0\n");
    const struct {
        const char *options, *range;
    } kCases[] = {
        {" --strict", "0 0 0 to 0.24926686 0.24926686 0.29325515"},  // 300 takes ten bits
        {" --read-output-bitdepth 8 --normalize-output", "0 0 0 to 0.85 0.85 1.0000001"},
        {" --read-output-bitdepth input --read-format-3dl scratch",
         "-0.060036387 -0.060036387 -0.060036387 to 0.9605822 0.9605822 1.1406913"},
    };
    for (const auto& each : kCases)
        test::expectIn(run(std::string("info a.3dl") + each.options).out,
                       std::string("\nrange           ") + each.range + "\n");
}

TEST_F(InspectTest, EvalSendsColoursThroughATable) {
    folder_.write("a.cube", kLattice);
    expectAll({
        {"eval a.cube 0.25 0.5 0.5", 0, "0.5 0.25 0.375\n", ""},
        {"eval a.cube 0.25 0.75 1 --mode step", 0, "0 0 0.25\n", ""},
        {"eval a.cube 0.25 0.5 0.5 --mode staggered", 0, "0.5 0.25 0.25\n", ""},
        {"eval a.cube --extrapolate -0.5 0 0", 0, "0 -0.5 0.5\n", ""},
        {"eval a.cube 0.25 0.5 0.75 --mode tetrahedral", 0, "0.5 0.25 0.3125\n", ""},
        {"eval a.cube 0 0 0 --mode tetrahedral --strict", 2, "",
         "orlith: error: --mode tetrahedral does not go with --strict\n"},
        {"eval a.cube 1e-60 +1 1e60", 0, "1 0 0.25\n", ""},
        {"eval a.cube 1e-60 +1 1e60 --strict", 0, "nan nan nan\n", ""},
        {"eval a.cube nan inf -inf", 0, "1 0 0.5\n", ""},
        {"eval a.cube -.5 1 -nan", 0, "1 0 0.5\n", ""},
        {"eval a.cube 1 1 0x1", 2, "", "orlith: error: \"1 1 0x1\" is not three numbers\n"},
        {"eval a.cube 0,25 1,0 0", 0, "1 0.25 0.5\n", ""},
        {"eval a.cube 0.25 1 0", 0, "1 0.25 0.5\n", ""},
        {"eval a.cube 0.25,1,0", 0, "1 0.25 0.5\n", ""},
    });
    EXPECT_EQ(output("eval - 0.25 0.5 0.5 --from .CUBE", kLattice), "0.5 0.25 0.375\n");
    EXPECT_EQ(output("eval a.cube", ""), "");
    EXPECT_EQ(output("eval a.cube", "0 0 0\r\n\n \t1\t0.25 +1e0 \n-1 5 nan"),
              "0 0 0.5\n0.25 1 0.25\n1 0 0.5\n");
    EXPECT_EQ(output("eval a.cube", "\xef\xbb\xbf# R G B\n0, 0, 0\n.25;1;0\n0,25 1,0 0,0\n"),
              "0 0 0.5\n1 0.25 0.5\n1 0.25 0.5\n");
    for (const std::string line : {"1 2", "1 2 3 4", "1 2 3x", "0,5, 0,5, 0,5"}) {
        const test::Outcome outcome = run("eval a.cube", "0 0 0\n\n" + line + "\n1 1 1\n");
        EXPECT_EQ(outcome.status, 1) << line;
        EXPECT_EQ(outcome.out, "0 0 0.5\n");
        EXPECT_EQ(outcome.err,
                  "orlith: error: standard input:3: \"" + line + "\" is not three numbers\n");
    }
}

/// What diff prints.
std::string table(const std::string& red, const std::string& green, const std::string& blue) {
    return "               largest          mean           rms  largest at\nred     " + red +
           "\ngreen   " + green + "\nblue    " + blue + "\n";
}

TEST_F(InspectTest, DiffComparesTables) {
    folder_.write("a.cube", kLattice);
    folder_.write("b.cube", test::replaced(kLattice, "0 0 0.25", "0.5 0 0.5"));
    folder_.write("curve2.cube", "LUT_1D_SIZE 2\n0 0 0\n1 1 1\n");
    folder_.write("curve3.cube", "LUT_1D_SIZE 3\n0 0 0\n0.5 0.5 0.75\n1 1 1\n");
    folder_.write("wide3.cube", "LUT_1D_SIZE 3\nDOMAIN_MAX 2 2 2\n0 0 0\n1 1 1\n2 2 2\n");
    folder_.write("nan.cube", "LUT_1D_SIZE 2\n0 0 0\n1 nan 1\n");
    const std::string none = "             0             0             0  -";
    const std::string all = table(none, none, none);
    const std::string some = table("           0.5        0.0625      0.176777  0 0 1", none,
                                   "          0.25       0.03125     0.0883883  0 0 1");
    const std::string bent =
        table(none, none, "          0.25     0.0833333      0.144338  0.5 0.5 0.5");
    const std::string wild = table(none, "           inf           inf           inf  1 1 1", none);
    expectAll({
        // By the book: sample by sample. NaN equals NaN, but nothing else.
        {"diff nan.cube nan.cube --strict", 0, all.c_str(), ""},
        {"diff nan.cube curve2.cube --tolerance 9e99 --strict", 1, wild.c_str(), ""},
        {"diff a.cube b.cube --strict", 1, some.c_str(), ""},
        {"diff a.cube b.cube --tolerance 0.5 --strict", 0, some.c_str(), ""},
        {"diff a.cube b.cube --tolerance 0.4999 --strict", 1, some.c_str(), ""},
        // Of other size: at the points of the larger, whichever comes first.
        {"diff curve2.cube curve3.cube --strict", 1, bent.c_str(), ""},
        {"diff curve3.cube curve2.cube --strict", 1, bent.c_str(), ""},
        {"diff a.cube none", 1, "", "orlith: error: none: No such file or directory\n"},
    });
    // Looks: at the points of the larger and at random colours.
    const struct {
        const char *command, *part;
        int status;
    } kLooks[] = {
        {"diff a.cube b.cube", "red                0.5     0.06", 1},
        {"diff curve2.cube curve3.cube", "  0.5 0.5 0.5\n", 1},
        {"diff a.cube b.cube --tolerance 0.5", "  0 0 1\n", 0},
        {"diff a.cube b.cube --json", "\"red\": {\"largest\": 0.5, \"at\": [0, 0, 1], ", 1},
        // Clamped at 1 and straight on to 2: apart by 1 where the wider one ends.
        {"diff curve2.cube wide3.cube --tolerance 0.9999", "  2 2 2\n", 1},
        {"diff curve2.cube wide3.cube --tolerance 1", "  2 2 2\n", 0},
        // A curve against a lattice with red and green swapped.
        {"diff a.cube curve2.cube --tolerance 1", "  1 0 0\n", 0},
    };
    for (const auto& each : kLooks) {
        const test::Outcome outcome = run(each.command);
        EXPECT_EQ(outcome.status, each.status) << each.command;
        test::expectIn(outcome.out, each.part);
    }
    EXPECT_EQ(run("diff - b.cube --from cube", read("b.cube")).status, 0);
}

}  // namespace
