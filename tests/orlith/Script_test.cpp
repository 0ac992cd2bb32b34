// The commands run, panel and pattern, and Ctrl-C.

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "tests/orlith/Program.h"

namespace {

class ScriptTest : public test::ProgramTest {
protected:
    /// Makes a FIFO, starts the program, which is to open it for reading, and presses Ctrl-C once
    /// it has. Then the FIFO gets its contents and its end.
    test::Outcome interruptWhileReading(const std::string& fifo, const std::string& command,
                                        const std::string& contents) const {
        const std::string path = folder_.path(fifo);
        EXPECT_EQ(mkfifo(path.c_str(), 0600), 0);
        test::Program program(folder_.path(""), command);
        const int writing = open(path.c_str(), O_WRONLY);  // waits for the reader
        program.interrupt();
        EXPECT_EQ(::write(writing, contents.data(), contents.size()),
                  static_cast<ssize_t>(contents.size()));
        close(writing);
        return program.wait();
    }
};

TEST_F(ScriptTest, RunLoadsNodesAndPressesButtons) {
    test::writePattern(folder_.path("p.exr"), 2);
    folder_.write("saved.tcl",
                  "# saved long ago\n"
                  "Read { file p.exr name input }\n"
                  "GenerateLUT { output_file first.cube name first }\n"
                  "GenerateLUT { file second.3dl scratch_compatible false }\n");
    EXPECT_EQ(output("run saved.tcl"), "");
    EXPECT_FALSE(exists("first.cube"));
    expect("run saved.tcl --press first.generate --press GenerateLUT1.generate", 0, "",
           "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n");
    EXPECT_EQ(output("eval first.cube 1 1 1"), "0.75 1 0\n");
    test::expectIn(read("second.3dl"), "\n3DMESH\n");
}

TEST_F(ScriptTest, RunSaysWhatIsWrong) {
    folder_.write("bare.tcl", "CMSTestPattern {size 2}\nGenerateLUT {file grade}\n");
    folder_.write("alone.tcl", "GenerateLUT {file grade.cube}\n");
    folder_.write("bad.tcl", "\nGenerateLUT {lut1d many}\n");
    expectAll({
        {"run none.tcl", 1, "", "orlith: error: none.tcl: cannot be read\n"},
        {"run .", 1, "", "orlith: error: .: is a folder\n"},
        {"run bad.tcl", 1, "",
         "orlith: error: bad.tcl:2: GenerateLUT1.lut1d: \"many\" is not an integer\n"},
        {"run bare.tcl --press GenerateLUT.generate", 1, "",
         "orlith: warning: GenerateLUT1: Error writing LUT file. Select a file type or set a"
         " \".type\" extension on the file name so that Zefra can determine the type of file to"
         " write.\n"
         "orlith: error: GenerateLUT1: Error writing LUT file. You must select the file type or"
         " set a \".type\" extension on the file name to indicate what type of file to write.\n"},
        {"run alone.tcl --press GenerateLUT1.generate", 1, "",
         "orlith: error: GenerateLUT1: input 0 is not connected\n"},
        {"run alone.tcl --press generate", 2, "",
         "orlith: error: --press: \"generate\" has to be NODE.CONTROL\n"},
        {"run alone.tcl --press Other.generate", 2, "",
         "orlith: error: --press: no node \"Other\"\n"},
    });
}

TEST_F(ScriptTest, PanelShowsTheControls) {
    EXPECT_EQ(output("panel --knob file=x.3dl --knob scratch_compatible=true --knob bitdepth_id=3"),
              "GenerateLUT1\n"
              "  output file               file                x.3dl\n"
              "  file type                 file_type               | [.3dl] | .blut | .cms | .csp"
              " | .cub | .cube | .vf\n"
              "\n3D LUT\n"
              "  input bit depth (.3dl)    bitdepth_id         4 bit | 8 bit | 10 bit | [12 bit]"
              " | 16 bit\n"
              "  output bit depth (.3dl)   output_bitdepth_id  [input bit depth] | 4 bit | 8 bit"
              " | 10 bit | 12 bit | 16 bit\n"
              "  clamp output              clamp_output        true\n"
              "  3dl file format           format_3dl_id       autodesk flame/smoke | autodesk"
              " lustre | assimulate scratch | [3]\n"
              "\n \n"
              "  (Generate and Write LUT File)  generate\n");
    expect("panel --knob clamp_output=0", 2, "",
           "orlith: error: GenerateLUT1: no control named \"clamp_output\"\n");
}

TEST_F(ScriptTest, PatternAndGenerateGiveTheIdentity) {
    EXPECT_EQ(output("pattern p.tif --size 4"), "p.tif: 4 x 4 x 4 test pattern, 56 x 56 pixels\n");
    EXPECT_EQ(output("generate p.tif i.blut --quiet"), "");
    test::expectIn(output("info i.blut"), "from identity   0 at most\n");
    EXPECT_EQ(run("pattern none/p.exr").status, 1);
}

// Ctrl-C.

TEST_F(ScriptTest, CancelledOperatorsWriteNothing) {
    test::writePattern(folder_.path("p.exr"), 2);
    const test::Outcome outcome =
        interruptWhileReading("saved.tcl", "run saved.tcl --press GenerateLUT1.generate",
                              "Read {file p.exr}\nGenerateLUT {file out.cube}\n");
    EXPECT_EQ(outcome.status, 130);
    EXPECT_EQ(outcome.err, "");
    EXPECT_FALSE(exists("out.cube"));
}

TEST_F(ScriptTest, CancellingEndsScriptsAndCommandsWithoutOperators) {
    EXPECT_EQ(interruptWhileReading("s.tcl", "run s.tcl", "while 1 {}\n").status, 130);
    EXPECT_EQ(interruptWhileReading("a.cube", "eval a.cube 0 0 0", "").status, 130);
}

TEST_F(ScriptTest, CancellingTakesAwayWhatWasWritten) {
    folder_.write("a.cube", "LUT_3D_SIZE 20\n0 0 0\n");
    const std::string path = folder_.path("out.cube");
    ASSERT_EQ(mkfifo(path.c_str(), 0600), 0);
    test::Program program(folder_.path(""), "convert a.cube out.cube --no-verify");
    const int reading = open(path.c_str(), O_RDONLY);  // waits for the writer
    // It has more to write than a FIFO holds, so it is there to be interrupted.
    program.interrupt();
    std::filesystem::remove(path);
    folder_.write("out.cube", "as if it had been written there");
    char bytes[4096];
    while (::read(reading, bytes, sizeof bytes) > 0) {
    }
    close(reading);
    EXPECT_EQ(program.wait().status, 130);
    EXPECT_FALSE(exists("out.cube"));
}

}  // namespace
