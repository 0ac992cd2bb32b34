// Images through tables: colours as the Evaluator has them, everything else as it was.

#include <OpenImageIO/imageio.h>
#include <fmt/format.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <boost/smart_ptr/make_shared.hpp>
#include <csignal>
#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <stdexcept>
#include <vector>

#include "lut/Evaluator.h"
#include "lut/LUT3D.h"
#include "lut/RampFill.h"
#include "lut/io/Registry.h"
#include "tests/orlith/Program.h"

namespace {

namespace ol = Orlith::LUT;
namespace fs = std::filesystem;
using Names = std::vector<std::string>;

/// Half a step of the type that a file's colours have, at 1.
float toleranceOf(const OIIO::ImageSpec& spec) {
    if (spec.channelformat(0) == OIIO::TypeFloat) return 1e-6F;
    if (spec.channelformat(0) == OIIO::TypeHalf) return 2.5e-4F;
    const int bits =
        spec.get_int_attribute("oiio:BitsPerSample", static_cast<int>(8 * spec.format.size()));
    return 0.51F / static_cast<float>((1 << bits) - 1);
}

/// An image as it stands in a file.
struct Picture {
    OIIO::ImageSpec spec;
    std::vector<std::byte> bytes;  // each channel in its own type
    std::vector<float> samples;

    explicit Picture(const std::string& path, int part = 0) {
        OIIO::ImageSpec wishes;
        wishes["oiio:UnassociatedAlpha"] = 1;
        const auto input = OIIO::ImageInput::open(path, &wishes);
        if (!input) throw std::runtime_error(path + ": " + OIIO::geterror());
        spec = input->spec(part);
        bytes.resize(spec.image_bytes(true));
        samples.resize(spec.image_pixels() * static_cast<std::size_t>(spec.nchannels));
        EXPECT_TRUE(input->read_image(part, 0, 0, -1, OIIO::TypeUnknown, bytes.data()) &&
                    input->read_image(part, 0, 0, -1, OIIO::TypeFloat, samples.data()))
            << path << input->geterror();
    }

    std::array<int, 3> places(const Names& channels) const {
        std::array<int, 3> places = {};
        for (std::size_t c = 0; c < 3; ++c)
            places[c] = spec.channelindex(channels[c]);
        return places;
    }

    const float* pixel(std::size_t index) const {
        return &samples[index * static_cast<std::size_t>(spec.nchannels)];
    }
};

class ApplyTest : public test::ProgramTest {
protected:
    ApplyTest() : look_(boost::make_shared<ol::LUT3D>()) {
        // The leak sanitizer does not survive threads of the image library that end as it looks.
        setenv("ASAN_OPTIONS", "detect_leaks=0", 1);
        look_->resize(3);
        for (std::size_t i = 0; i < std::size_t{3} * 27; ++i)
            look_->data()[i] = static_cast<float>(i * 11 % 17) / 16.0F;
        ol::setUnitDomain(*look_, 3, 3, 3);
        const std::string path = folder_.path("look.cube");
        ol::createWriter(path, false, "")->write(path, look_);
    }

    /// Writes parts whose samples differ everywhere.
    void write(const std::string& name, const std::vector<OIIO::ImageSpec>& parts) const {
        const std::string path = folder_.path(name);
        const auto output = OIIO::ImageOutput::create(path);
        bool isGood = output && output->open(path, static_cast<int>(parts.size()), parts.data());
        for (std::size_t part = 0; isGood && part < parts.size(); ++part) {
            std::vector<float> samples(parts[part].image_pixels() *
                                       static_cast<std::size_t>(parts[part].nchannels));
            for (std::size_t i = 0; i < samples.size(); ++i)
                samples[i] = static_cast<float>((i * 37 + part * 5) % 101) / 100.0F;
            isGood =
                (part == 0 || output->open(path, parts[part], OIIO::ImageOutput::AppendSubimage)) &&
                output->write_image(OIIO::TypeFloat, samples.data());
        }
        ASSERT_TRUE(isGood && output->close()) << path << output->geterror();
    }

    /// Expects the colours of `after` to be those of `before` behind the look.
    void expectLook(const Picture& before, const Picture& after, const std::array<int, 3>& rgb,
                    const std::array<int, 3>& rgbAfter) const {
        const ol::Evaluator evaluator(look_);
        const float tolerance = toleranceOf(after.spec);
        ASSERT_EQ(before.spec.image_pixels(), after.spec.image_pixels());
        for (std::size_t i = 0; i < before.spec.image_pixels(); ++i) {
            float colour[3];
            for (std::size_t c = 0; c < 3; ++c)
                colour[c] = before.pixel(i)[rgb[c]];
            evaluator.apply(colour, colour, 1);
            for (std::size_t c = 0; c < 3; ++c)
                ASSERT_NEAR(after.pixel(i)[rgbAfter[c]], colour[c], tolerance) << i << ' ' << c;
        }
    }

    boost::shared_ptr<ol::LUT3D> look_;
};

/// Expects the same bytes in all channels but three, and the same metadata.
void expectOthersKept(const Picture& before, const Picture& after,
                      const std::array<int, 3>& except) {
    const OIIO::ImageSpec& spec = before.spec;
    ASSERT_EQ(after.bytes.size(), before.bytes.size());
    for (int channel = 0; channel < spec.nchannels; ++channel) {
        if (std::count(except.begin(), except.end(), channel) > 0) continue;
        const std::size_t pixelBytes = spec.pixel_bytes(true);
        for (std::size_t at = spec.pixel_bytes(0, channel, true); at < before.bytes.size();
             at += pixelBytes) {
            ASSERT_EQ(
                std::memcmp(&before.bytes[at], &after.bytes[at], spec.channel_bytes(channel, true)),
                0)
                << channel;
        }
    }
    const auto numbers = [](const OIIO::ImageSpec& each) {
        return std::vector<int>{
            each.x,          each.y,           each.width,        each.height,
            each.full_x,     each.full_y,      each.full_width,   each.full_height,
            each.tile_width, each.tile_height, each.alpha_channel};
    };
    EXPECT_EQ(numbers(after.spec), numbers(spec));
    EXPECT_EQ(after.spec.channelnames, spec.channelnames);
    EXPECT_EQ(after.spec.format, spec.format);
    EXPECT_EQ(after.spec.channelformats, spec.channelformats);
    EXPECT_EQ(after.spec.extra_attribs.size(), spec.extra_attribs.size());
    for (const OIIO::ParamValue& each : spec.extra_attribs)
        EXPECT_EQ(after.spec.extra_attribs.get_string(each.name()), each.get_string());
}

/// The share of pixels whose red is above a limit.
double redsAbove(float limit, const Picture& picture) {
    std::size_t count = 0;
    for (std::size_t i = 0; i < picture.spec.image_pixels(); ++i)
        count += picture.pixel(i)[0] > limit ? 1 : 0;
    return static_cast<double>(count) / static_cast<double>(picture.spec.image_pixels());
}

OIIO::ImageSpec specOf(const Names& channels, const char* type, int width = 21, int height = 40) {
    OIIO::ImageSpec spec(width, height, static_cast<int>(channels.size()), OIIO::TypeDesc(type));
    spec.channelnames = channels;
    spec.alpha_channel = -1;
    for (std::size_t i = 0; i < channels.size(); ++i) {
        if (channels[i] == "A") spec.alpha_channel = static_cast<int>(i);
    }
    return spec;
}

TEST_F(ApplyTest, ChangesColoursAndKeepsTheRest) {
    const Names kRGB = {"R", "G", "B"};
    const Names kRGBA = {"R", "G", "B", "A"};
    OIIO::ImageSpec mixed = specOf({"A", "B", "G", "R", "Z", "id"}, "half", 100, 300);
    mixed.channelformats = {OIIO::TypeHalf, OIIO::TypeHalf,  OIIO::TypeHalf,
                            OIIO::TypeHalf, OIIO::TypeFloat, OIIO::TypeUInt32};
    mixed.x = -7;
    mixed.y = 12;
    mixed.full_width = 400;
    mixed.full_height = 200;
    mixed["owner"] = "the grade";
    mixed["compression"] = "piz";
    OIIO::ImageSpec tiled = mixed;
    tiled.tile_width = 32;
    tiled.tile_height = 16;
    OIIO::ImageSpec unassociated = specOf(kRGBA, "uint16");
    unassociated["oiio:UnassociatedAlpha"] = 1;
    OIIO::ImageSpec edgeTiles = specOf({"R", "G", "B", "Z", "A"}, "uint8", 130, 70);
    edgeTiles.tile_width = edgeTiles.tile_height = 64;
    OIIO::ImageSpec planes = specOf(kRGBA, "uint8", 64, 300);
    planes["planarconfig"] = "separate";
    OIIO::ImageSpec tenBits = specOf(kRGB, "uint16");
    tenBits["oiio:BitsPerSample"] = 10;
    const struct {
        const char* name;
        OIIO::ImageSpec spec;
    } kImages[] = {
        {"mixed.exr", mixed},
        {"tiled.exr", tiled},
        {"float.exr", specOf(kRGB, "float", 1, 1)},
        {"wide.exr", specOf(kRGBA, "half", 60000, 2)},
        {"float.tif", specOf({"R", "G", "B", "A", "Z"}, "float")},
        {"unassociated.tif", unassociated},
        {"edge-tiles.tif", edgeTiles},
        {"planes.tif", planes},
        {"alpha.png", unassociated},
        {"plain.png", specOf(kRGB, "uint8")},
        {"ten.dpx", tenBits},
        {"plain.tga", specOf(kRGB, "uint8")},
    };
    for (const auto& each : kImages) {
        SCOPED_TRACE(each.name);
        write(each.name, {each.spec});
        const std::string name = each.name;
        const Picture before(folder_.path(name));
        output(fmt::format("apply {0} out-{0} --lut look.cube --threads 3 --quiet", name));
        const Picture after(folder_.path("out-" + name));
        const std::array<int, 3> rgb = {0, 1, 2};  // of an EXR file as well, when it is read
        expectLook(before, after, rgb, rgb);
        expectOthersKept(before, after, rgb);
    }
    // In place, and through another table that undoes nothing.
    const Picture before(folder_.path("alpha.png"));
    folder_.write("swap.cube", "LUT_1D_SIZE 2\n1 0 0\n0 1 1\n");
    EXPECT_EQ(output("apply alpha.png alpha.png --lut swap.cube --lut swap.cube"),
              "alpha.png: 21 x 40 pixels, uint16\n");
    EXPECT_EQ(Picture(folder_.path("alpha.png")).bytes, before.bytes);
}

TEST_F(ApplyTest, DividesByAlphaIfTold) {
    // Colours of 0.25 behind alpha: 0.25 becomes 0.75; what has none is 0.25 itself.
    folder_.write("curve.cube", "LUT_1D_SIZE 5\n0 0 0\n.75 .75 .75\n.8 .8 .8\n.9 .9 .9\n1 1 1\n");
    const std::array<float, 4> alphas = {0.0F, 0.25F, 0.5F, 1.0F};
    OIIO::ImageSpec spec(4, 1, 4, OIIO::TypeFloat);
    spec.channelnames = {"R", "G", "B", "A"};
    spec.alpha_channel = 3;
    std::vector<float> samples;
    for (const float alpha : alphas) {
        const float colour = alpha == 0.0F ? 0.25F : 0.25F * alpha;
        samples.insert(samples.end(), {colour, colour, colour, alpha});
    }
    const auto writer = OIIO::ImageOutput::create(folder_.path("edge.exr"));
    ASSERT_TRUE(writer->open(folder_.path("edge.exr"), spec) &&
                writer->write_image(OIIO::TypeFloat, samples.data()) && writer->close());
    expect("apply edge.exr out.exr --lut curve.cube --unpremultiply --quiet", 0, "", "");
    const Picture after(folder_.path("out.exr"));
    for (std::size_t i = 0; i < alphas.size(); ++i) {
        EXPECT_FLOAT_EQ(after.samples[4 * i], alphas[i] == 0.0F ? 0.75F : 0.75F * alphas[i]);
        EXPECT_EQ(after.samples[4 * i + 3], alphas[i]);
    }
    write("plain.png", {specOf({"R", "G", "B"}, "uint8")});
    expect(
        "apply plain.png out.png --lut curve.cube --unpremultiply --quiet", 0, "",
        "orlith: warning: plain.png: its colours are not multiplied by alpha, and not divided by "
        "it\n");
}

TEST_F(ApplyTest, OfSeveralPartsOneChanges) {
    OIIO::ImageSpec depth = specOf({"Z"}, "float");
    OIIO::ImageSpec beauty = specOf({"R", "G", "B", "A"}, "half");
    OIIO::ImageSpec light =
        specOf({"key.R", "key.G", "key.B", "fill.R", "fill.G", "fill.B"}, "half");
    depth["oiio:subimagename"] = "depth";
    beauty["oiio:subimagename"] = "beauty";
    light["oiio:subimagename"] = "light";
    write("parts.exr", {depth, beauty, light});
    const struct {
        const char* options;
        int changed;
        Names colours;
        const char* warning;
    } kCases[] = {
        {"",
         1,
         {"R", "G", "B"},
         "orlith: warning: parts.exr: holds 3 parts: took part 1 \"beauty\"; "
         "choose with --part or --layer\n"},
        {" --layer fill", 2, {"fill.R", "fill.G", "fill.B"}, ""},
    };
    for (const auto& each : kCases) {
        expect("apply parts.exr out.exr --lut look.cube --quiet" + std::string(each.options), 0, "",
               each.warning);
        for (int part = 0; part < 3; ++part) {
            const Picture before(folder_.path("parts.exr"), part);
            const Picture after(folder_.path("out.exr"), part);
            std::array<int, 3> rgb = {-1, -1, -1};
            if (part == each.changed) {
                rgb = before.places(each.colours);
                expectLook(before, after, rgb, rgb);
            }
            expectOthersKept(before, after, rgb);
        }
    }
}

TEST_F(ApplyTest, SaysWhatAnotherFormatDoesNotHold) {
    OIIO::ImageSpec window = specOf({"R", "G", "B", "A", "Z"}, "half");
    window.x = 3;
    window.full_width = 40;
    write("window.exr", {window});
    write("plain.tif", {specOf({"R", "G", "B"}, "uint16")});
    write("layers.exr", {specOf({"R", "G", "B", "a.R", "a.G", "a.B"}, "float")});
    write("parts.tif", {specOf({"R", "G", "B"}, "uint8"), specOf({"R", "G", "B"}, "uint8")});
    const struct {
        const char *from, *to, *options;
        Names colours;
        const char* type;
        std::vector<const char*> warnings;
    } kCases[] = {
        {"plain.tif", "o.exr", "", {"R", "G", "B"}, "float", {}},
        {"plain.tif", "o.dpx", " --type uint10", {"R", "G", "B"}, "uint10", {}},
        {"plain.tif",
         "o.bmp",
         "",
         {"R", "G", "B"},
         "uint8",
         {"o.bmp: holds no uint16: R, G, B become uint8"}},
        {"window.exr",
         "o.png",
         "",
         {"R", "G", "B"},
         "uint16",
         {"o.png: holds no channel Z; left out",
          "o.png: holds no half: R, G, B, A become uint16 from 0 to 1",
          "o.png: holds no such data window; its pixels become the whole picture"}},
        {"layers.exr",
         "o.jpg",
         " --layer a --type uint8",
         {"a.R", "a.G", "a.B"},
         "uint8",
         {"o.jpg: holds no channels R, G, B; left out"}},
        {"plain.tif",
         "o.gif",
         "",
         {"R", "G", "B"},
         "uint8",
         {"o.gif: holds no uint16: R, G, B become uint8"}},
        {"parts.tif",
         "o.tga",
         " --part 1",
         {"R", "G", "B"},
         "uint8",
         {"o.tga: holds one image; the other parts are left out"}},
    };
    folder_.write("dark.cube", "DOMAIN_MAX 0.5 1 1\nLUT_1D_SIZE 2\n0 0 0\n0.5 1 1\n");
    expect("apply plain.tif o.exr --lut dark.cube --quiet --extrapolate", 0, "",
           "orlith: warning: plain.tif: " +
               fmt::format("{:.3g}", 100.0 * redsAbove(0.5F, Picture(folder_.path("plain.tif")))) +
               " % of its colours are outside the domain of dark.cube, 0 0 0 to 0.5 1 1, and held"
               " at its edge\n");
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::string(each.from) + ' ' + each.to);
        const std::string to = each.to;
        std::string warnings;
        for (const std::string warning : each.warnings)
            warnings += "orlith: warning: " + warning + '\n';
        expect("apply " + std::string(each.from) + ' ' + to + " --lut look.cube" + each.options, 0,
               to + ": 21 x 40 pixels, " + each.type + "\n", warnings);
        const Picture before(folder_.path(each.from), to == "o.tga" ? 1 : 0);
        const Picture after(folder_.path(to));
        if (to == "o.jpg" || to == "o.png" || to == "o.gif")
            continue;  // lossy; multiplied by alpha
        expectLook(before, after, before.places(each.colours), {0, 1, 2});
    }
}

TEST_F(ApplyTest, RefusesWhatCannotBeDone) {
    write("grey.tif", {specOf({"Y"}, "uint8")});
    write("two.tif", {specOf({"Y", "A"}, "uint8")});
    write("good.exr", {specOf({"R", "G", "B"}, "half", 300, 300)});
    folder_.write("cut.exr", read("good.exr").substr(0, read("good.exr").size() / 2));
    folder_.write("bad.cube", "LUT_3D_SIZE 2\n0 0 0\n");
    write("wide.tif", {specOf({"R", "G", "B"}, "uint8", 70000, 1)});
    const struct {
        const char *command, *error;
    } kCases[] = {
        {"grey.tif o.tif --lut look.cube", "grey.tif: needs red, green and blue channels, has 1"},
        {"two.tif o.tif --lut look.cube", "two.tif: needs red, green and blue channels, has 2"},
        {"none.exr o.exr --lut look.cube", "none.exr: No such file or directory"},
        {"good.exr none/o.exr --lut look.cube", "none/o.exr: there is no folder none"},
        {"good.exr o.exr --lut none.cube", "none.cube: No such file or directory"},
        {"good.exr o.exr --lut bad.cube", "bad.cube:2: Iridas LUT reader: syntax error"},
        {"good.exr o.png --lut look.cube --type half",
         "o.png: .png files hold uint8, uint16, not half"},
        {"cut.exr o.exr --lut look.cube", "cut.exr: "},
        {"good.exr o.xyz --lut look.cube", "o.xyz: "},
        // Wider than the headers can say, and than the library bears.
        {"wide.tif o.gif --lut look.cube --quiet", "o.gif: its format does not hold such an image"},
        {"wide.tif o.jpg --lut look.cube", "o.jpg: a JPEG file has at most 65500 pixels"},
    };
    for (const auto& each : kCases) {
        const test::Outcome outcome = run("apply " + std::string(each.command));
        EXPECT_EQ(outcome.status, 1) << each.command;
        const std::string start = std::string("orlith: error: ") + each.error;
        EXPECT_EQ(outcome.err.substr(0, start.size()), start);
        EXPECT_EQ(outcome.err.find('\n'), outcome.err.size() - 1) << outcome.err;
    }
    EXPECT_EQ(std::distance(fs::directory_iterator(folder_.path("")), {}), 7);
}

TEST_F(ApplyTest, RunsOverTheFramesOfASequence) {
    for (const char* const frame : {"0008", "0009", "0010", "0011"})
        write("in." + std::string(frame) + ".exr", {specOf({"R", "G", "B"}, "half", 4, 3)});
    EXPECT_EQ(output("apply in.####.exr out%02d.png --lut look.cube --type uint8 --frames 8-11x2"),
              "out08.png: 4 x 3 pixels, uint8\nout10.png: 4 x 3 pixels, uint8\n");
    EXPECT_FALSE(exists("out09.png"));
    // Before anything is done; what is said of one frame is not said of all.
    expect("apply in.####.exr no.#.exr --lut look.cube --frames 10-13", 1, "",
           "orlith: error: in.0012.exr: No such file or directory\n");
    EXPECT_FALSE(exists("no.10.exr"));
    expect("apply in.%04d.exr out#.bmp --lut look.cube --frames 8-9 --quiet", 0, "",
           "orlith: warning: out8.bmp: holds no half: R, G, B become uint8 from 0 to 1\n");
    EXPECT_TRUE(exists("out9.bmp"));
}

TEST_F(ApplyTest, WheneverItIsCancelledTheImageIsTheOldOrTheNewOne) {
    write("in.exr", {specOf({"R", "G", "B", "A"}, "half", 1000, 700)});
    expect("apply in.exr whole.exr --lut look.cube --quiet", 0, "", "");
    const std::string whole = read("whole.exr");
    int cancelled = 0;
    for (int moment = 0; moment < 16; ++moment) {
        folder_.write("o.exr", "precious");
        test::Program program(folder_.path(""), "apply in.exr o.exr --lut look.cube --quiet");
        usleep(static_cast<useconds_t>(moment) * 20000);
        program.send(SIGINT);
        const int status = program.wait().status;
        EXPECT_EQ(read("o.exr") == "precious", status == 130) << status;
        EXPECT_TRUE(status == 130 || read("o.exr") == whole) << status;
        cancelled += status == 130 ? 1 : 0;
    }
    EXPECT_GT(cancelled, 0);
    EXPECT_EQ(std::distance(fs::directory_iterator(folder_.path("")), {}), 4);
}

}  // namespace
