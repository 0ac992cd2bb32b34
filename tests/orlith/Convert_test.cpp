#include <map>
#include <ostream>
#include <regex>
#include <vector>

#include "tests/orlith/Program.h"

namespace {

/// What the program says of a pair of formats, a line for each letter.
std::string wordsFor(const std::string& letters, const std::string& extension) {
    const std::map<char, const char*> kWords = {
        {'p', "warning: converted$EXT: a $EXT file cannot hold the table's pre-LUT"},
        {'c', "warning: converted$EXT: a .csp file does not give a pre-LUT back as it was"},
        {'d', "warning: converted$EXT: a $EXT file does not keep the table's domain"},
        {'P',
         "error: converted$EXT: unable to write: expecting pre-LUT data (--lut1d 1024 --style1d"
         " linear gives it some)"},
    };
    std::string text;
    if (extension == ".3dl") {
        text = "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n";
    }
    for (const char letter : letters)
        text.append("orlith: ").append(kWords.at(letter)).append("\n");
    return std::regex_replace(text, std::regex("\\$EXT"), extension);
}

struct Pairs {
    const char* from;
    std::vector<const char*> to;
};
void PrintTo(const Pairs& pairs, std::ostream* out) {
    *out << pairs.from;
}

class PairsTest : public test::ProgramTest, public ::testing::WithParamInterface<Pairs> {};

TEST_P(PairsTest, ConvertOrSayWhyNot) {
    const char* const kTargets[] = {".cube", ".3dl", ".blut", ".cms", ".csp", ".cub", ".vf"};
    const std::string from = std::string("generated.") + GetParam().from;
    test::writePattern(folder_.path("p.exr"), 3);
    ASSERT_EQ(run("generate p.exr " + from).status, 0);
    for (std::size_t i = 0; i < std::size(kTargets); ++i) {
        const std::string to = std::string("converted") + kTargets[i];
        const std::string letters = GetParam().to[i];
        const test::Outcome outcome =
            run(std::string("convert ").append(from).append(" ").append(to));
        EXPECT_EQ(outcome.err, wordsFor(letters, kTargets[i]));
        const bool isRefused = letters == "P";
        EXPECT_EQ(outcome.status, isRefused ? 1 : 0) << to;
        const std::string summary = to + ": " + kTargets[i] + ", 3 x 3 x 3 points, largest ";
        EXPECT_EQ(outcome.out.substr(0, summary.size()), isRefused ? "" : summary);
    }
    // The point (1, 1, 1) of 3.
    const bool hasCodes = std::string(GetParam().from) == "3dl";
    test::expectIn(output("info converted.cube --values"),
                   hasCodes ? "\n0.500489 0.250244 0.500489\n" : "\n0.5 0.25 0.5\n");
}

// clang-format off
INSTANTIATE_TEST_SUITE_P(Formats, PairsTest, ::testing::Values(
    //            .cube .3dl  .blut .cms .csp .cub .vf
    Pairs{"cube", {"",   "",   "",   "P", "",   "",  "d"}},
    Pairs{"3dl",  {"",   "",   "",   "P", "",   "",  "d"}},
    Pairs{"blut", {"",   "",   "",   "P", "",   "",  "d"}},
    Pairs{"cms",  {"p",  "p",  "p",  "",  "c",  "",  "pd"}},
    Pairs{"csp",  {"",   "",   "",   "",  "",   "",  "d"}},
    Pairs{"cub",  {"pd", "pd", "pd", "d", "cd", "",  "pd"}},
    Pairs{"vf",   {"d",  "d",  "d",  "P", "d",  "d", ""}}),
    [](const auto& each) { return std::string("From_") + each.param.from; });
// clang-format on

using ConvertTest = test::ProgramTest;

TEST_F(ConvertTest, WritesATableAsItIsTold) {
    folder_.write("a.cube",
                  "LUT_3D_SIZE 2\n0 0 0\n1 0 0\n0 1 0\n1 1 0\n0 0 1\n1 0 1\n0 1 1\n1 1 2\n");
    const struct {
        const char *files, *options, *head, *data;
    } kCases[] = {
        {"a.cube o.3dl", "--bitdepth 8", "for flame\n", "\n0 255 \n0 0 0\n0 0 255\n"},
        {"a.cube o.3dl", "--format-3dl lustre --output-bitdepth 12", "for lustre\n",
         "\n3DMESH\nMesh 0 12\n0 1023 \n0 0 0\n0 0 4095\n"},
        {"a.cube o.3dl", "--format-3dl scratch", "for scratch\n",
         "\n0 1023 \n15 15 15\n15 15 1017\n"},
        {"a.cube o.3dl", "--format-3dl scratch --scale 0.5 --offset 90", "for scratch\n",
         "\n0 1023 \n90 90 90\n90 90 602\n"},
        {"a.cube o.3dl", "--no-clamp-output", "for flame\n", "\n1023 1023 2046\n"},
        {"a.cube o.cms", "--lut1d 3 --style1d linear", "LUT_1D_SIZE 3\n",
         "\n0.500000 0.500000 0.500000\n1.000000"},
        {"o.cms o.cub", "--lut1d 9", "# lutLength 3\n", "\n0.250000 0.250000 0.250000\n"},  // kept
    };
    for (const auto& each : kCases) {
        const std::string files = each.files;
        EXPECT_EQ(run("convert " + files + " " + each.options).status, 0) << each.options;
        const std::string written = read(files.substr(files.find(' ') + 1));
        test::expectIn(written, each.head);
        test::expectIn(written, each.data);
    }
}

TEST_F(ConvertTest, SaysWhyNot) {
    folder_.write("curve.cube", "LUT_1D_SIZE 3\n0 0 0\n0.5 0.25 0.125\n1 1 1\n");
    folder_.write("bad.cube", "LUT_3D_SIZE 2\n0 0 0\n1 x\n");
    folder_.write("few.cube", "LUT_3D_SIZE 128\n0 0 0\n");
    folder_.write("two.cube", "LUT_3D_SIZE 1\n0 0 0\n");
    folder_.write("huge.cube", "LUT_3D_SIZE 2000\n0 0 0\n");
    folder_.write("table", read("curve.cube"));
    std::filesystem::create_directory(folder_.path("folder.cube"));
    std::filesystem::create_symlink("/dev/full", folder_.path("full.cube"));
    expectAll({
        {"convert curve.cube curve.cube", 0, "curve.cube: .cube, 3 entries, largest deviation 0\n",
         ""},
        {"convert curve.cube c.3dl", 1, "",
         "orlith: error: c.3dl: unable to write: must be a 3D lut\n"},
        {"convert curve.cube c.blut", 1, "",
         "orlith: error: c.blut: a .blut file is written of lattices only\n"},
        {"convert curve.cube none/c.csp", 1, "",
         "orlith: error: none/c.csp: No such file or directory\n"},
        {"convert none.cube c.csp", 1, "", "orlith: error: none.cube: No such file or directory\n"},
        {"convert folder.cube c.csp", 1, "", "orlith: error: folder.cube: is a folder\n"},
        {"convert bad.cube c.csp", 1, "",
         "orlith: error: bad.cube:3: Iridas LUT reader: syntax error while reading LUT data.\n"},
        {"convert huge.cube c.csp", 1, "",
         "orlith: error: huge.cube:1: declares a size that no table can have\n"},
        {"convert table c.csp", 1, "",
         "orlith: error: table: No reader found for extension \"\". (name the format by --from)\n"},
        {"convert table d --from cube --to .csp --quiet", 0, "", ""},
        {"convert d e --from csp --to cub", 1, "",
         "orlith: error: e: unable to write: must be a 3D lut\n"},
        {"convert curve.cube c.xyz", 1, "",
         "orlith: error: c.xyz: No writer found for extension \".xyz\". (name the format by "
         "--to)\n"},
        {"convert few.cube f.blut", 1, "",
         "orlith: error: few.cube: holds 1 samples, its table has 2097152 points\n"},
        {"convert two.cube f.cms", 1, "",
         "orlith: error: f.cms: unable to write: expecting pre-LUT data (--lut1d 1024 --style1d"
         " linear gives it some)\n"},
        {"convert curve.cube full.cube", 1, "",
         "orlith: error: full.cube: No space left on device\n"},
    });
    for (const char* const name : {"c.csp", "c.3dl", "c.blut", "c.xyz", "e"})
        EXPECT_FALSE(exists(name)) << name;
}

}  // namespace
