#include <unistd.h>

#include <csignal>
#include <cstdlib>
#include <sstream>

#include "tests/orlith/Program.h"

namespace {

namespace fs = std::filesystem;

/// (r / 2 + 0.25, g / 4, b)
#define LOOK "oiiotool {in} --mulc 0.5,0.25,1 --addc 0.25,0,0 -o {out}"

class BakeTest : public test::ProgramTest {
protected:
    BakeTest() {
        fs::create_directory(folder_.path("tmp"));
        setenv("TMPDIR", folder_.path("tmp").c_str(), 1);
    }
    ~BakeTest() override { unsetenv("TMPDIR"); }

    void expectNothingLeft() const { EXPECT_TRUE(fs::is_empty(folder_.path("tmp"))); }

    /// Whether a process runs whose number the program has left in a file.
    bool isAnyRunning(const std::string& file) const {
        std::istringstream numbers(read(file));
        for (std::string number; numbers >> number;) {
            if (!fs::exists("/proc/" + number)) continue;
            const std::string state = test::readFile("/proc/" + number + "/stat");
            if (state[state.rfind(')') + 2] != 'Z') return true;
        }
        return false;
    }
};

TEST_F(BakeTest, HasTheProgramsLookInEveryFormatByEveryImage) {
    test::writePattern(folder_.path("p.exr"), 5, [](const test::Pixel& colour) {
        return test::Pixel{colour.r / 2 + 0.25F, colour.g / 4, colour.b};
    });
    expect("generate p.exr expected.cube --quiet", 0, "", "");
    const struct {
        const char *file, *options, *remark, *tolerance;
    } kCases[] = {
        {"o.cube", "", "", "1e-6"},
        {"o.csp", "", "", "1e-6"},
        {"o.cms", "", "", "3e-6"},
        {"o.cub", "", "", "3e-6"},
        {"o.blut", "", "", "1e-6"},
        {"o.vf", "", "", "3e-6"},
        {"o.3dl", "--bitdepth 16 ", "", "1e-5"},
        {"o.cube", "--image-type tif ", " (16-bit tif images)", "1e-5"},
        {"o.cube", "--image-type dpx ", " (16-bit dpx images)", "1e-5"},
        {"o.cube", "--image-type png ", " (16-bit png images)", "1e-5"},
    };
    for (const auto& each : kCases) {
        const std::string file = each.file;
        SCOPED_TRACE(file + " " + each.options);
        const test::Outcome outcome =
            run("bake " + file + " --size 5 " + each.options + "-- " LOOK);
        EXPECT_EQ(outcome.status, 0) << outcome.err;
        test::expectIn(outcome.out, file + ": " + file.substr(1) + ", 5 x 5 x 5 points, largest ");
        test::expectIn(outcome.out, std::string(each.remark) + "\n");
        EXPECT_EQ(run("diff " + file + " expected.cube --tolerance " + each.tolerance).status, 0);
        expectNothingLeft();
    }
}

TEST_F(BakeTest, SendsColoursThroughTablesInTheirOrderAndThenThroughTheProgram) {
    const std::string curve = "LUT_1D_SIZE 2\n";
    folder_.write("scale.cube", curve + "0 0 0\n0.5 0.25 2\n");
    folder_.write("negative.cube", curve + "1 1 1\n0 0 0\n");
    folder_.write("wide.cube", curve + "DOMAIN_MIN -1 -1 -1\nDOMAIN_MAX 3 3 3\n0 0 0\n1 1 1\n");
    folder_.write("tent.cube", "LUT_1D_SIZE 3\n0 0 0\n1 1 1\n0.5 0.5 0.5\n");
    folder_.write("white.cube",
                  "LUT_3D_SIZE 2\n0 0 0\n0 0 0\n0 0 0\n0 0 0\n0 0 0\n0 0 0\n0 0 0\n1 1 1\n");
    const std::string clipped =
        "orlith: warning: 9 of 81 numbers behind the tables are below 0 or above 1, and clipped in"
        " 16-bit png images (--image-type exr keeps them)\n";
    const std::string narrowed =
        "orlith: warning: wide.cube: its domain is -1 -1 -1 to 3 3 3, what is baked covers 0 0 0 to"
        " 1 1 1\n";
    const std::string unused =
        "orlith: warning: wide.cube:2: the domain is not used: the table covers 0 to 1\n"
        "orlith: warning: wide.cube:3: the domain is not used: the table covers 0 to 1\n";
    const struct {
        const char *tables, *file, *summary;
        std::string err;
        const char *colour, *result;
    } kCases[] = {
        {"--lut scale.cube --lut negative.cube", "o.blut", "33 x 33 x 33 points,", "",
         "0.5 0.5 0.25", "0.75 0.875 0.5"},
        {"--lut negative.cube --lut scale.cube", "o.blut", "33 x 33 x 33 points,", "",
         "0.5 0.5 0.25", "0.25 0.125 1.5"},
        {"--lut white.cube --lut scale.cube", "o.blut", "2 x 2 x 2 points,", "", "0.5 0.5 0.5",
         "0.0625 0.03125 0.25"},
        {"--lut white.cube --size 3 --mode tetrahedral", "o.blut", "from the tables 0\n", "",
         "0.5 0.5 0.5", "0.5 0.5 0.5"},
        // At 0.5: 1 there, and 0.25 half-way between 0 and 0.5.
        {"--lut tent.cube --size 2", "o.blut", "from the tables 0.75\n", "", "0.5 0 1",
         "0.25 0 0.5"},
        {"--lut wide.cube --size 5", "o.blut", "5 x 5 x 5 points", "", "-0.5 1 2",
         "0.125 0.5 0.75"},
        {"--lut wide.cube --size 5", "o.vf", "5 x 5 x 5 points", narrowed, "0 0.5 1",
         "0.25 0.375 0.5"},
        {"--lut wide.cube --strict", "o.blut", "deviation 0\n", unused, "0 0.5 1", "0 0.5 1"},
        {"--lut scale.cube --size 3 -- dd if={in} of={out} status=none", "o.blut", "", "", "1 1 1",
         "0.5 0.25 2"},
        {"--lut scale.cube --size 3 -- " LOOK, "o.blut", "", "", "1 1 1", "0.5 0.0625 2"},
        {"--lut scale.cube --size 3 --image-type png -- " LOOK, "o.vf", "(16-bit png images)\n",
         clipped, "0 0 1", "0.25 0 1"},
        {"--lut wide.cube --size 5 -- " LOOK, "o.blut", "", narrowed, "0 0 1", "0.375 0.0625 0.5"},
    };
    for (const auto& each : kCases) {
        const std::string file = each.file;
        const std::string command = "bake " + file + " " + each.tables;
        SCOPED_TRACE(command);
        const test::Outcome outcome = run(command);
        EXPECT_EQ(outcome.status, 0);
        EXPECT_EQ(outcome.err, each.err);
        test::expectIn(outcome.out, each.summary);
        const test::Outcome value = run("eval " + file + " " + each.colour);
        std::istringstream expected(each.result), found(value.out);
        for (float a = 0, b = 1; expected >> a;) {
            found >> b;
            EXPECT_NEAR(a, b, file == "o.vf" ? 1e-5 : 0) << value.out;
        }
    }
}

TEST_F(BakeTest, SaysWhatIsWrongWithAProgramOrItsImage) {
    test::writePattern(folder_.path("p3.exr"), 3);
    test::writeImage(folder_.path("small.exr"), 20, 20, [](int, int) { return test::Pixel{}; });
    folder_.write("copy.sh", "cp $1 $2\n");
    folder_.write("talk.sh", "echo reading; printf 'bad \\033[2J\\n\\n' >&2; exit 3\n");
    folder_.write("die.sh", "kill -9 $$\n");
    folder_.write("lock.sh", "mkdir $2.d; touch $2.d/f; chmod 500 $2.d\n");
    const test::Case kCases[] = {
        {"-- none {in} {out}", 1, "", "none: cannot be run: No such file or directory\n"},
        {"-- ./copy.sh {in} {out}", 1, "", "./copy.sh: cannot be run: Permission denied\n"},
        {"-- false {in} {out}", 1, "", "false: failed with exit status 1\n"},
        {"-- sh die.sh {in} {out}", 1, "", "sh: ended by signal 9 (Killed)\n"},
        {"-- true {in} {out}", 1, "", "true: has left no image at {out}\n"},
        {"-- sh lock.sh {in} {out}", 1, "", "sh: has left no image at {out}\n"},
        {"-- mkdir {in}.d {out}", 1, "", "mkdir: has left no image at {out}\n"},
        {"-- touch {in} {out}", 1, "", "touch: has left an empty file at {out}\n"},
        {"-- sh copy.sh p3.exr {out} {in}", 1, "",
         "{out} of sh: holds a pattern of 3 points a side instead of 5\n"},
        {"-- sh copy.sh small.exr {out} {in}", 1, "",
         "{out} of sh: no pattern has 20 x 20 pixels; the nearest by its width, of 2 points, has 21"
         " x 21 (resized, cropped or padded?)\n"},
        {"--image-type png -- oiiotool {in} -flip -o {out}", 1, "",
         "{out} of oiiotool: its pattern of 5 points is mirrored top to bottom; undo that\n"},
        {"--lut none.cube -- sh copy.sh {in} {out}", 1, "",
         "none.cube: No such file or directory\n"},
    };
    for (const test::Case& each : kCases) {
        expect(std::string("bake o.cube --size 5 ") + each.command, each.status, each.out,
               std::string("orlith: error: ") + each.err);
        expectNothingLeft();
    }
    expect("bake o.cube -- sh talk.sh {in} {out}", 1, "",
           "reading\nbad \033[2J\n\n"
           "orlith: error: sh: failed with exit status 3: reading; bad \\x1b[2J\n");
    EXPECT_FALSE(exists("o.cube"));

    const test::Outcome forced =
        run("bake o.cube --size 5 --force -- sh copy.sh p3.exr {out} {in}");
    EXPECT_EQ(forced.status, 0);
    test::expectIn(forced.out, "3 x 3 x 3 points");
    test::expectIn(forced.err, "orlith: warning: {out} of sh: holds a pattern of 3 points");

    const std::string coarse =
        "orlith: warning: {out} of oiiotool: has uint8 samples, {in} has uint16: the table's "
        "colours are as coarse\n";
    expect("bake o.vf --size 6 --quiet --image-type png -- oiiotool {in} -d uint8 -o {out}", 0, "",
           coarse);

    const test::Outcome wild =
        run("bake o.cube --size 3 -- oiiotool {in} --subc 0.5 --powc 0.5 -o {out}");
    EXPECT_EQ(wild.status, 1);
    test::expectIn(wild.err, "samples that are not finite, which .cube files cannot hold\n");

    folder_.write("run.sh", "touch ran; cp $1 $2\n");
    for (const std::string file : {"none/o.cube", "o.3dl --size 66", "o.xyz"})
        EXPECT_EQ(run("bake " + file + " -- sh run.sh {in} {out}").status, 1) << file;
    EXPECT_FALSE(exists("ran"));
}

TEST_F(BakeTest, DoesNotWaitForWhatAProgramLeavesRunningNorKeepAllItPrints) {
    folder_.write("leave.sh", "sleep 1000 & echo $! >children; cp $1 $2\n");
    expect("bake o.blut --size 3 -- sh leave.sh {in} {out}", 0,
           "o.blut: .blut, 3 x 3 x 3 points, largest deviation 0\n", "");
    EXPECT_FALSE(isAnyRunning("children"));
    folder_.write("print.sh", "head -c 3000000 /dev/zero | tr '\\0' x; exit 1\n");
    const test::Outcome outcome = run("bake o.cube --size 3 -- sh print.sh {in} {out}");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_GT(outcome.err.size(), 3000000U);
    EXPECT_LT(outcome.err.size(), 3003000U);
}

TEST_F(BakeTest, WheneverASignalComesProgramAndFolderGo) {
    folder_.write("hang.sh", "echo $$ >children; sleep 1000 & echo $! >>children; wait\n");
    folder_.write("stay.sh", "trap '' TERM; echo $$ >children; sleep 1000; sleep 1000\n");
    const int signals[] = {SIGINT, SIGTERM, SIGHUP};
    for (int moment = 0; moment < 30; ++moment) {
        folder_.write("children", "");
        const int signal = signals[moment % 3];
        const bool isStubborn = moment == 27;
        test::Program program(folder_.path(""), isStubborn
                                                    ? "bake o.cube -- sh stay.sh {in} {out}"
                                                    : "bake o.cube -- sh hang.sh {in} {out}");
        while (isStubborn && read("children").empty())
            usleep(1000);
        usleep(static_cast<useconds_t>(moment) * 5000);
        program.send(signal);
        EXPECT_EQ(program.wait().status, 128 + signal) << moment;
        EXPECT_FALSE(isAnyRunning("children")) << moment;
    }
    EXPECT_FALSE(exists("o.cube"));
    expectNothingLeft();
}

}  // namespace
