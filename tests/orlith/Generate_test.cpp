#include <cmath>
#include <filesystem>
#include <limits>

#include "tests/orlith/Program.h"
#include "tests/support/Tables.h"

namespace {

using test::Words;
namespace fs = std::filesystem;

constexpr char kSizeWarning[] =
    "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n";
constexpr char kNoType[] =
    "orlith: error: Error writing LUT file. You must select the file type or set a \".type\""
    " extension on the file name to indicate what type of file to write.\n";

class GenerateTest : public test::ProgramTest {
protected:
    GenerateTest() { test::writePattern(folder_.path("p.exr"), 5); }

    /// Makes an image the only input; expects status 1 and this text, and no table.
    void expectRefused(const std::string& image, const std::string& message) const {
        expect({"generate", image, "out.cube"}, 1, "", "orlith: error: " + image + message);
        EXPECT_FALSE(exists("out.cube"));
    }
};

TEST_F(GenerateTest, RecordsALookInEveryFormat) {
    const struct {
        const char* name;
        Words options;
        float tolerance;
        const char *summary, *err;
        Words eval;  // what the point (1, 2, 3) of 5 stands for
    } kFormats[] = {
        {"o.cube", {}, 1e-6F, "largest deviation 0", "", {"0.25", "0.5", "0.75"}},
        {"o.csp", {}, 1e-6F, "largest deviation 0", "", {"0.25", "0.5", "0.75"}},
        // In steps of 1/5, not 1/4.
        {"o.vf", {}, 1e-6F, "largest deviation 0", "", {"0.2", "0.4", "0.6"}},
        {"o.blut", {}, 0.0F, "largest deviation 0", "", {"0.25", "0.5", "0.75"}},
        {"o.cms", {}, 1e-6F, "largest deviation 0", "", {}},
        {"o.cub", {"--lut1d", "7", "--style1d", "linear"}, 1e-6F, "largest deviation 0", "", {}},
        // A pre-LUT of one NaN.
        {"o.cub", {"--lut1d", "1"}, 1e-6F, "largest deviation 0", "", {}},
        {"o.3dl", {}, 0.0005F, "largest deviation 0.00049", kSizeWarning, {}},
        {"o.3dl",
         {"--format-3dl", "lustre", "--output-bitdepth", "12"},
         0.00013F,
         "largest deviation 0.00012",
         kSizeWarning,
         {}},
        {"o.3dl",
         {"--format-3dl", "scratch", "--bitdepth", "16"},
         1e-5F,
         "largest deviation 7.3e-06",
         "Warning: SCRATCH prefers 3DL files of 32x32x32\n",
         {}},
        {"o.3dl",
         {"--knob", "bitdepth_id=99"},
         1e-5F,
         "largest deviation 7.6e-06",
         kSizeWarning,
         {}},
    };
    for (const auto& format : kFormats) {
        Words arguments = {"generate", "p.exr", format.name};
        arguments.insert(arguments.end(), format.options.begin(), format.options.end());
        const std::string extension = fs::path(format.name).extension();
        expect(arguments, 0,
               std::string(format.name) + ": " + extension + ", 5 x 5 x 5 points, " +
                   format.summary + "\n",
               format.err);
        const auto lut = test::readBytes(extension, read(format.name), [](auto& reader) {
            namespace property = Orlith::Property;
            reader.setProperty("format3DL",
                               property::makeProperty<property::String>("format3DL", "auto"));
            reader.setProperty("outputBitDepth",
                               property::makeProperty<property::Int>("outputBitDepth", -2));
            reader.setProperty("normalizeOutput",
                               property::makeProperty<property::Int>("normalizeOutput", 0));
        });
        ASSERT_EQ(lut->width(), 5);
        for (const auto [r, g, b] : {std::array<int, 3>{1, 2, 3}, {4, 1, 0}, {0, 3, 2}}) {
            const test::Pixel expected =
                test::markedLook({static_cast<float>(r) / 4.0F, static_cast<float>(g) / 4.0F,
                                  static_cast<float>(b) / 4.0F});
            EXPECT_NEAR(lut->get(r, g, b)[0], expected.r, format.tolerance) << format.name;
            EXPECT_NEAR(lut->get(r, g, b)[1], expected.g, format.tolerance) << format.name;
            EXPECT_NEAR(lut->get(r, g, b)[2], expected.b, format.tolerance) << format.name;
        }
        if (format.eval.empty()) continue;
        Words eval = {"eval", format.name, "--mode", "step"};
        eval.insert(eval.end(), format.eval.begin(), format.eval.end());
        EXPECT_EQ(output(eval), "0.375 0.25 0.25\n") << format.name;
    }
}

TEST_F(GenerateTest, FollowsNamesTypesAndControls) {
    const struct {
        Words arguments;
        int status;
        const char *file, *out, *err;
    } kCases[] = {
        {{"grade"}, 1, nullptr, "", kNoType},
        {{"grade", "--file-type", ".cube"},
         0,
         "grade",
         "grade: .cube, 5 x 5 x 5 points, largest deviation 0\n",
         ""},
        {{"grade.cube", "--file-type", "csp", "--no-verify"},
         0,
         "grade.cube",
         "grade.cube: .csp, 5 x 5 x 5 points, not verified: --no-verify\n",
         ""},
        {{"o.vfz", "--quiet"}, 0, "o.vfz", "", ""},
        {{"o.cube", "--file-type", "", "--quiet"}, 0, "o.cube", "", ""},

        {{"o.cube", "--file-type", "png"},
         2,
         nullptr,
         "",
         "orlith: error: GenerateLUT1.file_type: \".png\" is not on the menu\n"},
        {{"o.3dl", "--lut1d", "5"},
         2,
         nullptr,
         "",
         "orlith: error: lut1d is not a control of .3dl files\n"},

        {{"o.cube", "--lut1d", "many"},
         2,
         nullptr,
         "",
         "orlith: error: GenerateLUT1.lut1d: \"many\" is not an integer\n"},
        {{"o.cube", "--knob", "colour=red"},
         2,
         nullptr,
         "",
         "orlith: error: GenerateLUT1: no control named \"colour\"\n"},
        {{"o.cube", "--knob", "file="},
         2,
         nullptr,
         "",
         "orlith: error: the output file has no name\n"},
        {{"o.3dl", "--knob", "format_3dl_id=3"},
         1,
         nullptr,
         "",
         "orlith: error: Error writing LUT file: 3DL file reader: invalid 3DL format specified for"
         " writing\n"},
        {{"none/o.cube"},
         1,
         nullptr,
         "",
         "orlith: error: Error writing LUT file: unable to open file for writing\n"},
        // Knobs come last, in their order.
        {{"o.cube", "--knob", "file=a=b.csp", "--knob", "lut1d=2", "--lut1d", "9"},
         0,
         "a=b.csp",
         "a=b.csp: .csp, 5 x 5 x 5 points, largest deviation 0\n",
         ""},
    };
    for (const auto& each : kCases) {
        Words arguments = {"generate", "p.exr"};
        arguments.insert(arguments.end(), each.arguments.begin(), each.arguments.end());
        expect(arguments, each.status, each.out, each.err);
        for (const auto& entry : fs::directory_iterator(folder_.path(""))) {
            const std::string name = entry.path().filename();
            if (name != "p.exr") {
                EXPECT_STREQ(each.file, name.c_str());
                fs::remove(entry.path());
                continue;
            }
        }
    }
}

TEST_F(GenerateTest, RefusesImagesThatAreNoPattern) {
    expectRefused("missing.exr", ": No such file or directory\n");
    fs::create_directory(folder_.path("folder.exr"));
    expectRefused("folder.exr", ": is a folder\n");
    const std::string whole = read("p.exr");
    for (const std::size_t byteCount : {std::size_t{0}, whole.size() - 100}) {
        folder_.write("cut.exr", whole.substr(0, byteCount));
        const test::Outcome outcome = run({"generate", "cut.exr", "out.cube"});
        EXPECT_EQ(outcome.status, 1) << byteCount;
        EXPECT_EQ(outcome.err.rfind("orlith: error: cut.exr: ", 0), 0U) << outcome.err;
        EXPECT_EQ(outcome.err.find('\n'), outcome.err.size() - 1) << outcome.err;
    }

    const auto black = [](int, int) { return test::Pixel{0, 0, 0}; };
    test::writeImage(folder_.path("narrow.exr"), 6, 70, black);
    expectRefused("narrow.exr",
                  ": 6 x 70 pixels are too few for a test pattern (patches of 7 x 7 pixels, 2"
                  " points)\n");
    test::writeImage(folder_.path("single.exr"), 13, 13, black);
    expectRefused("single.exr",
                  ": 13 x 13 pixels are too few for a test pattern (patches of 7 x 7 pixels, 2"
                  " points)\n");
    EXPECT_FALSE(exists("out.cube"));
}

TEST_F(GenerateTest, WarnsOfAPatternThatIsNotWhole) {
    const auto white = [](int, int) { return test::Pixel{1, 1, 1}; };
    test::writeImage(folder_.path("low.exr"), 84, 15, white);
    expect({"generate", "low.exr", "low.cube"}, 0,
           "low.cube: .cube, 5 x 5 x 5 points, largest deviation 0\n",
           "orlith: warning: low.exr: holds 24 patches, a 5-point pattern has 125\n");
    EXPECT_EQ(output({"eval", "low.cube", "0.75", "1", "0", "--mode", "step"}), "1 1 1\n");
    EXPECT_EQ(output({"eval", "low.cube", "1", "1", "0", "--mode", "step"}), "0 0 0\n");
    test::writeImage(folder_.path("odd.exr"), 91, 119, white);
    expect({"generate", "odd.exr", "odd.cube"}, 0,
           "odd.cube: .cube, 6 x 6 x 6 points, largest deviation 0\n",
           "orlith: warning: odd.exr: is 13 patches wide, a 6-point pattern 15\n");
}

TEST_F(GenerateTest, KeepsWhatIsNotFinite) {
    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    test::writePattern(folder_.path("wild.exr"), 2, [&](const test::Pixel& colour) {
        return test::Pixel{colour.r > 0 ? kInfinity : std::nanf(""), -kInfinity, 3e9F};
    });
    EXPECT_EQ(output({"generate", "wild.exr", "wild.cube", "--quiet"}), "");
    EXPECT_EQ(read("wild.cube").substr(47, 47), "nan -inf 3000000000.000000\ninf -inf 3000000000.");
    for (const std::string extension : {"blut", "vf"})
        EXPECT_EQ(output({"generate", "wild.exr", "wild." + extension, "--quiet"}), "");
    const struct {
        Words options;
        const char* codes;
    } kCases[] = {
        {{"--clamp-output"}, "0 0 1023\n0 0 1023\n0 0 1023\n0 0 1023\n1023 0 1023\n"},
        {{"--no-clamp-output"}, "0 -2147483648 2147483647\n"},
    };
    for (const auto& each : kCases) {
        Words arguments = {"generate", "wild.exr", "wild.3dl", "--quiet"};
        arguments.insert(arguments.end(), each.options.begin(), each.options.end());
        expect(arguments, 0, "", kSizeWarning);
        EXPECT_NE(read("wild.3dl").find(std::string("0 1023 \n") + each.codes), std::string::npos)
            << read("wild.3dl");
    }
}

TEST_F(GenerateTest, NoticesAFullDisk) {
    for (const char* const extension : {".cube", ".3dl"}) {
        const std::string name = std::string("full") + extension;
        fs::create_symlink("/dev/full", folder_.path(name));
        const test::Outcome outcome = run({"generate", "p.exr", name});
        EXPECT_EQ(outcome.status, 1);
        EXPECT_EQ(outcome.out, "");
        EXPECT_NE(outcome.err.find("orlith: error: " + name), std::string::npos) << outcome.err;
        EXPECT_NE(outcome.err.find("disk full?"), std::string::npos) << outcome.err;
        EXPECT_TRUE(exists(name)) << "what was there stays";
    }
}

TEST_F(GenerateTest, WritesTheSameFilesInEveryLocale) {
    EXPECT_EQ(output({"generate", "p.exr", "plain.csp", "--quiet"}), "");
    const test::Outcome german =
        run({"generate", "p.exr", "german.csp"}, "", {"LC_ALL=de_DE.UTF-8", "LANG=de_DE.UTF-8"});
    EXPECT_EQ(german.out, "german.csp: .csp, 5 x 5 x 5 points, largest deviation 0\n");
    EXPECT_EQ(read("german.csp"), read("plain.csp"));
}

}  // namespace
