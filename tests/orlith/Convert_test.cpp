#include <cmath>
#include <cstdlib>
#include <regex>

#include "tests/orlith/Program.h"

namespace {

using ConvertTest = test::ProgramTest;

std::string line(double r, double g, double b) {
    return std::to_string(r) + " " + std::to_string(g) + " " + std::to_string(b) + "\n";
}

/// Samples of a look with crosstalk, over a domain that is the same on each channel.
std::string lattice(int width, int height, int depth, double min = 0.0, double max = 1.0) {
    const auto input = [&](int i, int points) { return min + (max - min) * i / (points - 1); };
    std::string text;
    for (int b = 0; b < depth; ++b) {
        for (int g = 0; g < height; ++g) {
            for (int r = 0; r < width; ++r) {
                const double x = input(r, width);
                const double y = input(g, height);
                const double z = input(b, depth);
                text += line(0.8 * x + 0.1 * y * y, 0.9 * y + 0.1 * x * z, 0.5 * z + 0.2 * y);
            }
        }
    }
    return text;
}

std::string curve(int entries) {
    std::string text;
    for (int i = 0; i < entries; ++i) {
        const double t = static_cast<double>(i) / (entries - 1);
        text += line(std::sqrt(t), t * t, 1.0 - t);
    }
    return text;
}

constexpr char kUneven[] =
    "3\n0 0.2 1\n0 0.5 1\n"
    "2\n0 1\n0 1\n"
    "4\n0 0.1 0.5 1\n0 0.2 0.4 1\n\n";

TEST_F(ConvertTest, KeepsTheLookOfEveryKindInEveryFormat) {
    const std::string csp = "CSPLUTV100\n";
    const std::string plain = "2\n0 1\n0 1\n2\n0 1\n0 1\n2\n0 1\n0 1\n\n";
    folder_.write("lattice.cube", "LUT_3D_SIZE 5\n" + lattice(5, 5, 5));
    folder_.write("shaped.csp", csp + "3D\n\n" + kUneven + "5 5 5\n" + lattice(5, 5, 5));
    folder_.write("wide.cube", "LUT_3D_SIZE 5\nDOMAIN_MIN -1 -1 -1\nDOMAIN_MAX 2 2 2\n" +
                                   lattice(5, 5, 5, -1.0, 2.0));
    folder_.write("curve.cube", "LUT_1D_SIZE 9\n" + curve(9));
    folder_.write("shapedcurve.csp", csp + "1D\n\n" + kUneven + "9\n" + curve(9));
    folder_.write("block.cube", "LUT_1D_SIZE 9\nLUT_3D_SIZE 5\n" + curve(9) + lattice(5, 5, 5));
    folder_.write("unequal.csp", csp + "3D\n\n" + plain + "3 5 4\n" + lattice(3, 5, 4));
    for (const std::string from : {"lattice.cube", "shaped.csp", "wide.cube", "curve.cube",
                                   "shapedcurve.csp", "block.cube", "unequal.csp"}) {
        for (const std::string to : {".cube", ".3dl", ".blut", ".cms", ".csp", ".cub", ".vf"}) {
            const std::string pair = std::string(from).append(" o").append(to);
            const std::string command = "convert " + pair;
            SCOPED_TRACE(command);
            const test::Outcome outcome = run(command);
            EXPECT_EQ(outcome.status, 0) << outcome.err;
            const bool shrinks =
                from == "wide.cube" && to != ".cube" && to != ".blut" && to != ".csp";
            EXPECT_EQ(
                outcome.err.find("its domain changes from -1 -1 -1 to 2 2 2") != std::string::npos,
                shrinks);
            std::smatch reported;
            ASSERT_TRUE(std::regex_search(outcome.out, reported,
                                          std::regex("largest deviation ([0-9.e+-]+)")));
            // What convert says is what diff finds, at other places; rounded to two digits.
            const double deviation = std::strtod(reported[1].str().c_str(), nullptr);
            if (shrinks) continue;
            const std::string tolerance = std::to_string(deviation * 1.06 + 3e-6);
            EXPECT_EQ(
                run(std::string("diff ").append(pair).append(" --tolerance ") + tolerance).status,
                0)
                << outcome.out;
        }
    }
    for (const std::string exact :
         {"lattice.cube o.cms", "lattice.cube o.vf", "shaped.csp o.csp", "wide.cube o.blut",
          "wide.cube o.csp", "block.cube o.cub", "block.cube o.cms", "unequal.csp o.cub"}) {
        run("convert " + exact);
        EXPECT_EQ(run("diff " + exact + " --tolerance 3e-6").status, 0) << exact;
    }
}

TEST_F(ConvertTest, SaysWhatIsLostAndResamplesAsItIsTold) {
    folder_.write("a.cube",
                  "LUT_3D_SIZE 2\n0 0 0\n1 0 0\n0 1 0\n1 1 0\n0 0 1\n1 0 1\n0 1 1\n"
                  "1 1 1.5\n");
    // A pre-LUT that is a domain and no more.
    folder_.write("d.csp",
                  "CSPLUTV100\n3D\n\n2\n-8 8\n0 1\n2\n0 8\n0 1\n2\n0 8\n0 1\n\n2 2 2\n"
                  "0 0 0\n1 0 0\n0 1 0\n1 1 0\n0 0 1\n1 0 1\n0 1 1\n1 1 1\n");
    expectAll({
        {"convert d.csp d.cube", 0, "d.cube: .cube, 2 x 2 x 2 points, largest deviation 0\n", ""},
        {"eval d.csp 16 4 4 --extrapolate", 0, "1.5 0.5 0.5\n", ""},
        {"eval d.cube 0 12 4 --extrapolate", 0, "0.5 1.5 0.5\n", ""},
        {"convert a.cube o.3dl", 0,
         "o.3dl: .3dl, 2 x 2 x 2 points, largest deviation 0.5 (clipped: 1 numbers, the farthest"
         " 1.5)\n",
         "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n"},
        {"convert a.cube o.3dl --quiet", 0, "",
         "orlith: warning: o.3dl: clipped: 1 numbers, the farthest 1.5\n"
         "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n"},
        {"convert a.cube o.cube --size 9", 0,
         "o.cube: .cube, 9 x 9 x 9 points, largest deviation 5.4e-07 (resampled for another"
         " size)\n",
         ""},
        {"convert a.cube o.3dl --size 66", 1, "",
         "orlith: error: o.3dl: a .3dl file holds at most 65 points a side\n"},
        {"convert a.cube o.cms --strict", 1, "",
         "orlith: error: o.cms: unable to write: expecting pre-LUT data (without --strict and"
         " --lut1d it gets some that change nothing)\n"},
    });
}

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
    folder_.write("huge.cube", "LUT_3D_SIZE 2000\n0 0 0\n");
    folder_.write("table", read("curve.cube"));
    std::filesystem::create_directory(folder_.path("folder.cube"));
    std::filesystem::create_symlink("/dev/full", folder_.path("full.cube"));
    expectAll({
        {"convert curve.cube curve.cube", 0, "curve.cube: .cube, 3 entries, largest deviation 0\n",
         ""},
        {"convert curve.cube c.3dl --strict", 1, "",
         "orlith: error: c.3dl: unable to write: must be a 3D lut\n"},
        {"convert curve.cube c.blut --strict", 1, "",
         "orlith: error: c.blut: a .blut file is written of lattices only\n"},
        {"convert curve.cube none/c.csp", 1, "",
         "orlith: error: none/c.csp: there is no folder none\n"},
        {"convert none.cube c.csp", 1, "", "orlith: error: none.cube: No such file or directory\n"},
        {"convert folder.cube c.csp", 1, "", "orlith: error: folder.cube: is a folder\n"},
        {"convert bad.cube c.csp", 1, "",
         "orlith: error: bad.cube:3: Iridas LUT reader: syntax error while reading LUT data."
         " (\"x\" is no number)\n"},
        {"convert bad.cube c.csp --strict", 1, "",
         "orlith: error: bad.cube:3: Iridas LUT reader: syntax error while reading LUT data."
         " (the line has 2 words: \"1 x\")\n"},
        {"convert huge.cube c.csp", 1, "",
         "orlith: error: huge.cube:1: declares a size that no table can have\n"},
        {"convert table c.csp", 1, "",
         "orlith: error: table: No reader found for extension \"\". (name the format by --from: "
         "3dl, blut, cms, csp, cub, cube or vf)\n"},
        {"convert table d --from cube --to .csp --quiet", 0, "", ""},
        {"convert curve.cube c.xyz", 1, "",
         "orlith: error: c.xyz: No writer found for extension \".xyz\". (name the format by --to: "
         "3dl, blut, cms, csp, cub, cube or vf)\n"},
        {"convert few.cube f.blut", 1, "",
         "orlith: error: few.cube:2: Iridas LUT reader: syntax error while reading LUT data. (the"
         " file ends after 1 of 2097152 samples)\n"},
        {"convert few.cube f.blut --strict", 1, "",
         "orlith: error: few.cube: holds 1 samples, its table has 2097152 points\n"},
        {"convert curve.cube full.cube", 1, "",
         "orlith: error: full.cube: No space left on device\n"},
    });
    for (const char* const name : {"c.csp", "c.3dl", "c.blut", "c.xyz"})
        EXPECT_FALSE(exists(name)) << name;
}

}  // namespace
