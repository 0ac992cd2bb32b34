// The commands run, panel and pattern.

#include "tests/orlith/Program.h"

namespace {

using ScriptTest = test::ProgramTest;

TEST_F(ScriptTest, RunLoadsNodesAndPressesButtons) {
    test::writePattern(folder_.path("p.exr"), 2);
    folder_.write("saved.tcl",
                  "# saved long ago\n"
                  "Read { file p.exr name input }\n"
                  "GenerateLUT { output_file first.cube name first }\n"
                  "GenerateLUT { file second.3dl scratch_compatible false }\n");
    EXPECT_EQ(output("run saved.tcl"), "");
    EXPECT_FALSE(exists("first.cube"));
    expect("run saved.tcl --press first.generate --press GenerateLUT1.generate", 0,
           "first.cube: .cube, 2 x 2 x 2 points, largest deviation 0\n"
           "second.3dl: .3dl, 2 x 2 x 2 points, largest deviation 0.00025\n",
           "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n");
    EXPECT_EQ(output("eval first.cube 1 1 1"), "0.75 1 0\n");
    test::expectIn(read("second.3dl"), "\n3DMESH\n");
}

TEST_F(ScriptTest, RunSaysWhatIsWrong) {
    folder_.write("bare.tcl", "CMSTestPattern {size 2}\nGenerateLUT {file grade}\n");
    folder_.write("alone.tcl", "GenerateLUT {file grade.cube}\n");
    folder_.write("empty.tcl", "CMSTestPattern {size 2}\nGenerateLUT {lut1d 2}\n");
    std::filesystem::create_symlink("/dev/full", folder_.path("full.csp"));
    folder_.write("full.tcl", "CMSTestPattern {size 2}\nGenerateLUT {file full.csp}");
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
        {"run empty.tcl --press GenerateLUT.generate", 1, "",
         "orlith: error: GenerateLUT1: nothing was written: its control \"file\" is empty\n"},
        {"run full.tcl --press GenerateLUT.generate", 1, "",
         "orlith: error: GenerateLUT1: Error writing LUT file: not all of the file could be"
         " written\n"},
        {"run alone.tcl --press generate", 2, "",
         "orlith: error: --press: \"generate\" has to be NODE.CONTROL\n"},
        {"run alone.tcl --press Other.generate", 2, "",
         "orlith: error: --press: no node \"Other\"\n"},
        {"run bare.tcl --press GenerateLUT.generate --press GenerateLUT.file", 2, "",
         "orlith: warning: GenerateLUT1: Error writing LUT file. Select a file type or set a"
         " \".type\" extension on the file name so that Zefra can determine the type of file to"
         " write.\n"
         "orlith: error: --press: GenerateLUT1 has no button \"file\"\n"},
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

}  // namespace
