#include <filesystem>
#include <ostream>

#include "tests/orlith/Program.h"

namespace {

using test::Words;

constexpr char kCurve[] = "LUT_1D_SIZE 3\n0 0 0\n0.5 0.25 0.125\n1 1 1\n";

class ConvertTest : public test::ProgramTest {};

/// What the program says of a pair of formats, one letter for each line:
///   p  the pre-LUT is lost              c  .csp does not give it back
///   P  refused: a pre-LUT is needed     d  the domain is lost
std::string wordsFor(const std::string& letters, const std::string& file,
                     const std::string& extension) {
    std::string text;
    for (const char letter : letters) {
        const bool isRefused = letter == 'P';
        text += std::string("orlith: ") + (isRefused ? "error: " : "warning: ") + file + ": ";
        if (letter == 'P') text += "unable to write: expecting pre-LUT data";
        if (letter == 'p') text += "a " + extension + " file cannot hold the table's pre-LUT";
        if (letter == 'c') text += "a .csp file does not give a pre-LUT back as it was";
        if (letter == 'd') text += "a " + extension + " file does not keep the table's domain";
        text += "\n";
    }
    return text;
}

struct Pairs {
    const char* from;
    Words to;
};
void PrintTo(const Pairs& pairs, std::ostream* out) {
    *out << pairs.from;
}

class PairsTest : public test::ProgramTest, public ::testing::WithParamInterface<Pairs> {};

TEST_P(PairsTest, ConvertOrSayWhyNot) {
    const Words kTargets = {".cube", ".3dl", ".blut", ".cms", ".csp", ".cub", ".vf"};
    const std::string from = std::string("generated.") + GetParam().from;
    test::writePattern(folder_.path("p.exr"), 3);
    ASSERT_EQ(run({"generate", "p.exr", from, "--quiet"}).status, 0);
    for (std::size_t i = 0; i < kTargets.size(); ++i) {
        const std::string& letters = GetParam().to[i];
        const std::string to = "converted" + kTargets[i];
        SCOPED_TRACE(to);
        const test::Outcome outcome = run({"convert", from, to});
        const std::string sizeWarning =
            kTargets[i] == ".3dl"
                ? "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n"
                : "";
        EXPECT_EQ(outcome.err, sizeWarning + wordsFor(letters, to, kTargets[i]));
        const bool isRefused = letters == "P";
        EXPECT_EQ(outcome.status, isRefused ? 1 : 0);
        const std::string summary = to + ": " + kTargets[i] + ", 3 x 3 x 3 points, largest ";
        EXPECT_EQ(outcome.out.substr(0, summary.size()), isRefused ? "" : summary);
    }
    // Values, told by one of them: the look of the point (1, 1, 1) of 3 is (0.5, 0.25, 0.5).
    const std::string values = output({"info", "converted.cube", "--values"});
    const std::string middle = GetParam().from == std::string("3dl")
                                   ? "\n0.500489 0.250244 0.500489\n"
                                   : "\n0.5 0.25 0.5\n";
    EXPECT_NE(values.find(middle), std::string::npos) << values;
}

INSTANTIATE_TEST_SUITE_P(Formats, PairsTest,
                         ::testing::Values(
                             //            .cube .3dl  .blut .cms .csp .cub .vf
                             Pairs{"cube", {"", "", "", "P", "", "", "d"}},
                             Pairs{"3dl", {"", "", "", "P", "", "", "d"}},
                             Pairs{"blut", {"", "", "", "P", "", "", "d"}},
                             Pairs{"cms", {"p", "p", "p", "", "c", "", "pd"}},
                             Pairs{"csp", {"", "", "", "", "", "", "d"}},
                             Pairs{"cub", {"pd", "pd", "pd", "d", "cd", "", "pd"}},
                             Pairs{"vf", {"d", "d", "d", "P", "d", "d", ""}}),
                         [](const auto& each) { return std::string("From_") + each.param.from; });

TEST_F(ConvertTest, GivesAPreLUTToATableThatHasNone) {
    folder_.write("a.cube",
                  "LUT_3D_SIZE 2\n0 0 0\n1 0 0\n0 1 0\n1 1 0\n0 0 1\n1 0 1\n0 1 1\n1 1 1\n");
    EXPECT_EQ(output({"convert", "a.cube", "a.cms", "--lut1d", "3", "--style1d", "linear"}),
              "a.cms: .cms, 2 x 2 x 2 points, largest deviation 0\n");
    EXPECT_NE(read("a.cms").find("LUT_1D_SIZE 3\n"), std::string::npos);
    EXPECT_NE(read("a.cms").find("\n0.500000 0.500000 0.500000\n1.000000"), std::string::npos);
    // One that has a pre-LUT keeps it.
    EXPECT_EQ(output({"convert", "a.cms", "b.cub", "--lut1d", "9"}),
              "b.cub: .cub, 2 x 2 x 2 points, largest deviation 0\n");
    EXPECT_NE(read("b.cub").find("# lutLength 3\n"), std::string::npos);
}

TEST_F(ConvertTest, WritesA3dlFileAsItIsTold) {
    folder_.write("a.cube",
                  "LUT_3D_SIZE 2\n0 0 0\n1 0 0\n0 1 0\n1 1 0\n0 0 1\n1 0 1\n0 1 1\n1 1 2\n");
    const struct {
        Words options;
        const char *head, *codes;
    } kCases[] = {
        {{"--bitdepth", "8"}, "for flame\n", "\n0 255 \n0 0 0\n0 0 255\n"},
        {{"--format-3dl", "lustre", "--output-bitdepth", "12"},
         "for lustre\n",
         "\n3DMESH\nMesh 0 12\n0 1023 \n0 0 0\n0 0 4095\n"},
        {{"--format-3dl", "scratch"}, "for scratch\n", "\n0 1023 \n15 15 15\n15 15 1017\n"},
        {{"--format-3dl", "scratch", "--scale", "0.5", "--offset", "90"},
         "for scratch\n",
         "\n0 1023 \n90 90 90\n90 90 602\n"},
        {{"--no-clamp-output"}, "for flame\n", "\n1023 1023 2046\n"},
    };
    for (const auto& each : kCases) {
        Words arguments = {"convert", "a.cube", "a.3dl"};
        arguments.insert(arguments.end(), each.options.begin(), each.options.end());
        EXPECT_EQ(run(arguments).status, 0) << ::testing::PrintToString(each.options);
        EXPECT_NE(read("a.3dl").find(each.head), std::string::npos) << read("a.3dl");
        EXPECT_NE(read("a.3dl").find(each.codes), std::string::npos) << read("a.3dl");
    }
}

TEST_F(ConvertTest, SaysWhyNot) {
    folder_.write("curve.cube", kCurve);
    folder_.write("bad.cube", "LUT_3D_SIZE 2\n0 0 0\n1 x\n");
    folder_.write("few.cube", "LUT_3D_SIZE 128\n0 0 0\n");
    folder_.write("huge.cube", "LUT_3D_SIZE 2000\n0 0 0\n");
    folder_.write("table", kCurve);
    std::filesystem::create_directory(folder_.path("folder.cube"));
    std::filesystem::create_symlink("/dev/full", folder_.path("full.cube"));
    const struct {
        Words arguments;
        int status;
        const char *out, *err;
    } kCases[] = {
        {{"curve.cube", "c.csp"}, 0, "c.csp: .csp, 3 entries, largest deviation 0\n", ""},
        {{"curve.cube", "curve.cube"},
         0,
         "curve.cube: .cube, 3 entries, largest deviation 0\n",
         ""},
        {{"curve.cube", "c.3dl"},
         1,
         "",
         "orlith: error: c.3dl: unable to write: must be a 3D lut\n"},
        {{"curve.cube", "c.blut"}, 1, "", "orlith: error: c.blut: height: not available\n"},
        {{"curve.cube", "none/c.csp"},
         1,
         "",
         "orlith: error: none/c.csp: unable to open file for writing\n"},
        {{"none.cube", "c.csp"},
         1,
         "",
         "orlith: error: none.cube: Iridas LUT reader: unable to open file.\n"},
        {{"folder.cube", "c.csp"}, 1, "", "orlith: error: folder.cube: is a folder\n"},
        {{"bad.cube", "c.csp"},
         1,
         "",
         "orlith: error: bad.cube:3: Iridas LUT reader: syntax error while reading LUT data.\n"},
        {{"huge.cube", "c.csp"},
         1,
         "",
         "orlith: error: huge.cube:1: declares a size that no table can have\n"},
        {{"table", "c.csp"},
         1,
         "",
         "orlith: error: table: No reader found for extension \"%s\". (\"\"; name the format by"
         " --from)\n"},
        {{"table", "d", "--from", "cube", "--to", ".csp", "--quiet"}, 0, "", ""},
        {{"d", "e", "--from", "csp", "--to", "cub"},
         1,
         "",
         "orlith: error: e: unable to write: must be a 3D lut\n"},
        {{"curve.cube", "c.xyz"},
         1,
         "",
         "orlith: error: c.xyz: No writer found for extension \"%s\". (\".xyz\"; name the format by"
         " --to)\n"},

        {{"few.cube", "f.blut"},
         0,
         "f.blut: .blut, 128 x 128 x 128 points, not verified: a .blut of more than 127 points"
         " cannot be read back\n",
         "orlith: warning: few.cube: holds 1 samples, its table has 2097152 points\n"},
        {{"curve.cube", "full.cube"},
         1,
         "",
         "orlith: error: full.cube:1: Iridas LUT reader: LUT failed to initialise. (while reading"
         " back what was written; disk full?)\n"},
    };
    for (const auto& each : kCases) {
        Words arguments = {"convert"};
        arguments.insert(arguments.end(), each.arguments.begin(), each.arguments.end());
        expect(arguments, each.status, each.out, each.err);
    }
    for (const char* const name : {"c.3dl", "c.blut", "c.xyz", "e"})
        EXPECT_FALSE(exists(name)) << name;
}

}  // namespace
