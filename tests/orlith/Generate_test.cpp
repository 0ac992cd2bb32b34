#include <cmath>
#include <cstdlib>
#include <limits>

#include "tests/orlith/Program.h"

namespace {

namespace fs = std::filesystem;

#define SIZE_WARNING "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n"

#define WILD_WARNING                                                                          \
    "orlith: warning: wild.exr: 16 of 24 samples are not finite, the first in the patch at x" \
    " 0 and y 0 from the bottom left (a division by zero, the logarithm of a negative number?)\n"

#define OTHER_LOOK(extension, deviation, cure)                       \
    "orlith: warning: o" extension ": programs that read " extension \
    " files see a look that is off by " deviation                    \
    ": the operator's pre-LUT from 0 to 1 reaches"                   \
    " the first cell of the lattice only; " cure "\n"

class GenerateTest : public test::ProgramTest {
protected:
    GenerateTest() { test::writePattern(folder_.path("p.exr"), 5); }
};

TEST_F(GenerateTest, RecordsALookInEveryFormat) {
    const struct {
        const char *options, *summary, *warning;
        const char* sample;  // at point (1, 2, 3): (0.375, 0.25, 0.25)
    } kCases[] = {
        {"o.cube", "0", "", "0.375 0.25 0.25"},
        {"o.blut", "0", "", "0.375 0.25 0.25"},
        {"o.vf", "0", "", "0.375 0.25 0.25"},
        {"o.cms", "0",
         OTHER_LOOK(".cms", "0.95",
                    "generate o.cube and make it by \"orlith convert o.cube o.cms\""),
         "0.375 0.25 0.25"},
        {"o.cub --lut1d 7 --style1d linear", "0",
         OTHER_LOOK(".cub", "0.94", "--lut1d 0 leaves it away"), "0.375 0.25 0.25"},
        {"o.cub --lut1d 0", "0", "", "0.375 0.25 0.25"},
        {"o.3dl", "0.00049", SIZE_WARNING, "0.37536657 0.25024438 0.25024438"},
        {"o.3dl --format-3dl lustre --output-bitdepth 12", "0.00013", SIZE_WARNING,
         "0.37509158 0.25006106 0.25006106"},
        {"o.3dl --knob bitdepth_id=4", "7.7e-06", SIZE_WARNING, "0.37500572 0.2500038 0.2500038"},
        {"o.3dl --format-3dl scratch --bitdepth 16", "7.4e-06",
         "Warning: SCRATCH prefers 3DL files of 32x32x32\n", "0.3749977 0.25000367 0.25000367"},
    };
    for (const auto& each : kCases) {
        const std::string options = each.options;
        const std::string name = options.substr(0, options.find(' '));
        expect("generate p.exr " + options, 0,
               name + ": " + name.substr(1) + ", 5 x 5 x 5 points, largest deviation " +
                   each.summary + "\n",
               each.warning);
        const std::string values = output("info --values " + name);
        std::size_t line = values.find("\nfaults");
        for (int i = 0; i < 1 + 1 + 5 * 2 + 25 * 3; ++i)
            line = values.find('\n', line + 1);
        EXPECT_EQ(values.substr(line + 1, values.find('\n', line + 1) - line - 1), each.sample)
            << options;
    }
}

TEST_F(GenerateTest, FollowsNamesTypesAndControls) {
    const struct {
        test::Case run;
        const char* file;  // the only one that is written
    } kCases[] = {
        {{"grade", 1, "",
          "orlith: error: grade: Error writing LUT file. You must select the file type or set a"
          " \".type\" extension on the file name to indicate what type of file to write.\n"},
         nullptr},
        {{"grade.cube --file-type csp --no-verify", 0,
          "grade.cube: .csp, 5 x 5 x 5 points, not verified: --no-verify\n", ""},
         "grade.cube"},
        {{"o.vfz --quiet", 0, "", ""}, "o.vfz"},
        {{"O.CSP", 0, "O.CSP: .csp, 5 x 5 x 5 points, largest deviation 0\n", ""}, "O.CSP"},
        // Knobs come last, in their order.
        {{"o.cube --knob file=a=b.csp --knob lut1d=2 --lut1d 9", 0,
          "a=b.csp: .csp, 5 x 5 x 5 points, largest deviation 0\n", ""},
         "a=b.csp"},
        {{"o.3dl --lut1d 5", 2, "", "orlith: error: lut1d is not a control of .3dl files\n"},
         nullptr},
        {{"o.cube --knob colour=red", 2, "",
          "orlith: error: GenerateLUT1: no control named \"colour\"\n"},
         nullptr},
        {{"o.cube --knob file=", 2, "", "orlith: error: the output file has no name\n"}, nullptr},
        {{"none/o.cube", 1, "", "orlith: error: none/o.cube: there is no folder none\n"}, nullptr},
    };
    for (const auto& [each, file] : kCases) {
        expect(std::string("generate p.exr ") + each.command, each.status, each.out, each.err);
        if (file != nullptr) {
            EXPECT_TRUE(fs::remove(folder_.path(file))) << file;
        }
        EXPECT_EQ(std::distance(fs::directory_iterator(folder_.path("")), {}), 1) << each.command;
    }
}

TEST_F(GenerateTest, RefusesImagesThatAreNoPattern) {
    const auto black = [](int, int) { return test::Pixel{0, 0, 0}; };
    test::writeImage(folder_.path("narrow.exr"), 6, 70, black);
    test::writeImage(folder_.path("single.exr"), 13, 13, black);
    expectAll({
        {"generate missing.exr o.cube", 1, "",
         "orlith: error: missing.exr: No such file or directory\n"},
        {"generate narrow.exr o.cube", 1, "",
         "orlith: error: narrow.exr: 6 x 70 pixels are too few for a test pattern (patches of 7 x"
         " 7 pixels, 2 points)\n"},
        {"generate single.exr o.cube", 1, "",
         "orlith: error: single.exr: 13 x 13 pixels are too few for a test pattern (patches of 7"
         " x 7 pixels, 2 points)\n"},
        {"generate p.exr o.cube --part 1", 1, "",
         "orlith: error: p.exr: has no part 1; it has 0\n"},
        {"generate p.exr o.cube --layer a", 1, "",
         "orlith: error: p.exr: has no layer \"a\"; it has none\n"},
    });
    EXPECT_FALSE(exists("o.cube"));
}

TEST_F(GenerateTest, TakesWhatIsNoPatternByForce) {
    test::writeImage(folder_.path("low.exr"), 84, 15, [](int, int) {
        return test::Pixel{1, 1, 1};
    });
    const std::string reason =
        "low.exr: no pattern has 84 x 15 pixels; the nearest by its width, of 5 points, has 84 x 77"
        " (resized, cropped or padded?)\n";
    expect("generate low.exr o.cube", 1, "", "orlith: error: " + reason);
    expect("generate low.exr o.cube --force --quiet", 0, "", "orlith: warning: " + reason);
}

TEST_F(GenerateTest, KeepsWhatIsNotFinite) {
    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    test::writePattern(folder_.path("wild.exr"), 2, [&](const test::Pixel& colour) {
        return test::Pixel{colour.r > 0 ? kInfinity : std::nanf(""), -kInfinity, 3e9F};
    });
    expect("generate wild.exr wild.cube --quiet", 0, "", WILD_WARNING);
    EXPECT_EQ(read("wild.cube").substr(47, 47), "nan -inf 3000000000.000000\ninf -inf 3000000000.");
    expect("generate wild.exr wild.3dl --quiet", 0, "", WILD_WARNING SIZE_WARNING);
    test::expectIn(read("wild.3dl"),
                   "0 1023 \n0 0 1023\n0 0 1023\n0 0 1023\n0 0 1023\n1023 0 1023");
}

TEST_F(GenerateTest, WritesTheSameFilesInEveryLocale) {
    EXPECT_EQ(output("generate p.exr plain.csp --quiet"), "");
    setenv("LC_ALL", "de_DE.UTF-8", 1);
    const std::string summary = output("generate p.exr german.csp");
    unsetenv("LC_ALL");
    EXPECT_EQ(summary, "german.csp: .csp, 5 x 5 x 5 points, largest deviation 0\n");
    EXPECT_EQ(read("german.csp"), read("plain.csp"));
}

}  // namespace
