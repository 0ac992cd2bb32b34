#include "host/ImageFile.h"

#include <OpenImageIO/imageio.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

#include "tests/host/HostFixture.h"

namespace {

using test::failureOf;

/// The value that tells a sample's place in the file: column, line counted downward, channel, part.
float mark(int column, int line, int channel, int part = 0) {
    return static_cast<float>(column + 10 * line + 100 * channel + 1000 * part);
}

OIIO::ImageSpec markedSpec(const std::vector<std::string>& channels) {
    OIIO::ImageSpec spec(4, 3, static_cast<int>(channels.size()), OIIO::TypeFloat);
    spec.channelnames = channels;
    spec["oiio:subimagename"] = "with " + channels[0];
    return spec;
}

/// Writes an image, of one or several parts, whose samples tell their places.
void writeMarked(const std::string& path, const std::vector<OIIO::ImageSpec>& parts) {
    const auto output = OIIO::ImageOutput::create(path);
    bool isGood = output->open(path, static_cast<int>(parts.size()), parts.data());
    for (std::size_t part = 0; part < parts.size(); ++part) {
        const OIIO::ImageSpec& spec = parts[part];
        std::vector<float> samples;
        for (int pixel = 0; pixel < 4 * 3; ++pixel) {
            for (int channel = 0; channel < spec.nchannels; ++channel)
                samples.push_back(mark(pixel % 4, pixel / 4, channel, static_cast<int>(part)));
        }
        isGood = isGood &&
                 (part == 0 || output->open(path, spec, OIIO::ImageOutput::AppendSubimage)) &&
                 output->write_image(OIIO::TypeFloat, samples.data());
    }
    ASSERT_TRUE(isGood && output->close()) << path;
}

/// Expects row y of a file, from column x on, to hold one line of the marked image.
/// @param place  part and channels that hold red, green and blue
void expectLine(host::ImageFile& image, int y, int x, int line,
                const std::array<int, 4>& place = {0, 0, 1, 2}) {
    const auto [part, red, green, blue] = place;
    zefra::Row row(x, x + 4);
    image.copyRow(y, x, x + 4, zefra::kRGB, row);
    for (int column = 0; column < 4; ++column) {
        EXPECT_EQ(row.pixels(zefra::kRed)[column], mark(column, line, red, part));
        EXPECT_EQ(row.pixels(zefra::kGreen)[column], mark(column, line, green, part));
        EXPECT_EQ(row.pixels(zefra::kBlue)[column], mark(column, line, blue, part));
    }
}

/// Reads a row, so that the file's pixels have to be there.
void readRow(const std::string& path) {
    host::ImageFile image(path);
    zefra::Row row(0, 1);
    image.copyRow(image.box().y, 0, 1, zefra::kRGB, row);
}

using ImageFileTest = test::HostTest;

TEST_F(ImageFileTest, CountsRowsUpwardFromTheLastLine) {
    const std::string path = folder_.path("marked.exr");
    writeMarked(path, {markedSpec({"R", "G", "B"})});
    host::ImageFile image(path);
    EXPECT_EQ(image.box().width(), 4);
    EXPECT_EQ(image.box().height(), 3);
    for (int y = 0; y < 3; ++y)
        expectLine(image, y, 0, 2 - y);
}

TEST_F(ImageFileTest, TakesTheImageThatIsChosenOrMeant) {
    using Parts = std::vector<std::vector<std::string>>;
    const Parts stereo = {{"Z"}, {"R", "G", "B"}, {"A", "R", "G", "B"}};
    const Parts layers = {{"a.R", "a.G", "a.B", "b.red", "b.Green", "b.BLUE", "b.Z"}};
    const struct {
        Parts parts;
        host::ImageChoice choice;
        std::array<int, 4> place;  // part and channels that are taken
        const char* words;         // the remark, or what is wrong
    } kCases[] = {
        {{{"B", "G", "R"}}, {}, {0, 2, 1, 0}, ""},
        {{{"alpha", "red", "Green", "BLUE"}}, {}, {0, 1, 2, 3}, ""},
        {{{"R", "G", "Y", "B"}}, {}, {0, 0, 1, 3}, ""},
        {{{"t", "u", "v", "w", "x"}},
         {},
         {0, 0, 1, 2},
         "names none of 5 channels red, green and blue: took the first"},
        {{{"Z"}, {"u", "v", "w"}, {"R", "G", "B"}}, {}, {2, 0, 1, 2}, ""},
        {stereo, {}, {1, 0, 1, 2}, "holds 3 parts: took part 1 \"with R\""},
        {stereo, {2, ""}, {2, 1, 2, 3}, ""},
        {stereo, {0, ""}, {}, "needs red, green and blue channels, has 1"},
        {stereo, {3, ""}, {}, "has no part 3; it has 0 \"with Z\", 1 \"with R\", 2 \"with A\""},
        {stereo, {-1, "R"}, {}, "has no layer \"R\"; it has none"},
        {{{"l.R", "l.G", "l.B"}}, {}, {0, 0, 1, 2}, ""},
        {{{"R", "G", "B", "a.R", "a.G", "a.B"}}, {}, {0, 0, 1, 2}, ""},
        {layers, {}, {0, 0, 1, 2}, "holds 2 layers: took \"a\""},
        {layers, {-1, "b"}, {0, 3, 4, 5}, ""},
        {layers, {0, "c"}, {}, "has no layer \"c\"; it has \"a\", \"b\""},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(each.parts[0][0] + " " + each.words);
        const std::string path = folder_.path("parts.exr");
        std::vector<OIIO::ImageSpec> specs;
        for (const auto& channels : each.parts)
            specs.push_back(markedSpec(channels));
        writeMarked(path, specs);
        std::string words;
        const std::string failure = failureOf([&] {
            host::ImageFile image(path, each.choice);
            expectLine(image, 1, 0, 1, each.place);
            words = image.remark();
        });
        EXPECT_EQ(failure.empty() ? words : failure.substr(path.size() + 2), each.words);
    }
}

TEST_F(ImageFileTest, GivesRowsInAnyOrderHoweverTheFileIsLaidOut) {
    constexpr int kWidth = 900;  // several bands of lines
    constexpr int kHeight = 500;
    const struct {
        const char *name, *extension, *compression, *attribute, *value;
        int tileSide;
    } kCases[] = {
        {"blocks of 16", ".exr", "zip", "", "", 0},
        {"blocks of 256", ".exr", "dwab", "", "", 0},
        {"last line first", ".exr", "zips", "openexr:lineOrder", "decreasingY", 0},
        {"tiles", ".exr", "piz", "", "", 64},
        {"strips of 7", ".tif", "zip", "tiff:RowsPerStrip", "7", 0},
        {"one strip", ".tif", "none", "tiff:RowsPerStrip", "500", 0},
        {"one plane a channel", ".tif", "lzw", "planarconfig", "separate", 0},
        {"tiles", ".tif", "zip", "", "", 64},
    };
    // Exact as halves, too.
    const auto value = [](int column, int line, int channel) {
        return static_cast<float>((column % 5 + 7 * line + 2 * channel) % 512);
    };
    std::vector<float> samples;
    samples.reserve(std::size_t{3} * kWidth * kHeight);
    for (int i = 0; i < 3 * kWidth * kHeight; ++i)
        samples.push_back(value(i / 3 % kWidth, i / 3 / kWidth, i % 3));

    for (const auto& each : kCases) {
        SCOPED_TRACE(std::string(each.name) + each.extension);
        const std::string path = folder_.path(std::string("laid-out") + each.extension);
        OIIO::ImageSpec spec(kWidth, kHeight, 3, OIIO::TypeFloat);
        spec.tile_width = spec.tile_height = each.tileSide;
        spec["compression"] = each.compression;
        const std::string number = each.value;
        if (number.find_first_not_of("0123456789") == std::string::npos && !number.empty()) {
            spec[each.attribute] = std::stoi(number);
        } else if (*each.attribute != '\0') {
            spec[each.attribute] = number;
        }
        const auto output = OIIO::ImageOutput::create(path);
        ASSERT_TRUE(output->open(path, spec) &&
                    output->write_image(OIIO::TypeFloat, samples.data()) && output->close());
        {
            host::ImageFile image(path);
            zefra::Row row(0, kWidth);
            const bool isLossy = std::string(each.compression) == "dwab";
            for (const int y : {3, 499, 250, 10, 17, 16, 0, 400}) {
                image.copyRow(y, 0, kWidth, zefra::kRGB, row);
                for (int x = 0; x < kWidth; ++x) {
                    ASSERT_NEAR(row.pixels(zefra::kRed)[x], value(x, 499 - y, 0), isLossy ? 8 : 0);
                    ASSERT_NEAR(row.pixels(zefra::kBlue)[x], value(x, 499 - y, 2), isLossy ? 8 : 0);
                }
            }
        }
        std::filesystem::resize_file(path, std::filesystem::file_size(path) * 9 / 10);
        EXPECT_EQ(failureOf([&] {
                      host::ImageFile image(path);
                      zefra::Row row(0, 1);
                      image.copyRow(250, 0, 1, zefra::kRGB, row);
                  }).find(path + ": "),
                  0U);
    }
}

TEST_F(ImageFileTest, KeepsTheDataWindowWhereTheFileHasIt) {
    const std::string path = folder_.path("window.exr");
    OIIO::ImageSpec spec = markedSpec({"R", "G", "B"});
    spec.x = 5;  // within a display window of 20 x 10 from (0, 0)
    spec.y = 2;
    spec.full_width = 20;
    spec.full_height = 10;
    writeMarked(path, {spec});

    host::ImageFile image(path);
    EXPECT_EQ(image.box().x, 5);
    EXPECT_EQ(image.box().y, 5);  // 10 - (2 + 3)
    expectLine(image, 5, 5, 2);

    // Around the box there is black, in front of it, behind it, above it.
    zefra::Row row(-2, 12);
    image.copyRow(7, -2, 12, zefra::kRGB, row);
    const float* const green = row.pixels(zefra::kGreen) + 2;
    EXPECT_EQ(
        std::vector<float>(green + 4, green + 10),
        (std::vector<float>{0, mark(0, 0, 1), mark(1, 0, 1), mark(2, 0, 1), mark(3, 0, 1), 0}));
    image.copyRow(8, -2, 12, zefra::kRGB, row);
    EXPECT_EQ(green[5], 0.0F);
}

TEST_F(ImageFileTest, SaysWhatIsWrongWithAFile) {
    const std::string text = folder_.write("text.exr", "not an image\n");
    const std::string empty = folder_.write("empty.png", "");
    // 53 bytes that claim 4,800,000,000 bytes of float pixels.
    const std::string bomb =
        folder_.write("bomb.hdr", "#?RADIANCE\nFORMAT=32-bit_rle_rgbe\n\n-Y 20000 +X 20000\n");
    const struct {
        std::string path, reason;
    } kCases[] = {
        {text, ": \"" + text + "\" is not an OpenEXR file"},
        {empty, ": Not a PNG file"},
        {bomb, ": claims 20000 x 20000 pixels in 53 bytes"},
        {folder_.path("missing.exr"), ": No such file or directory"},
        {folder_.path("."), ": is a folder"},
    };
    for (const auto& each : kCases)
        EXPECT_EQ(failureOf([&] { readRow(each.path); }), each.path + each.reason);
}

TEST_F(ImageFileTest, FormatsHoldThePatternAndAreRefusedWhenCutOff) {
    constexpr float kHalfCode = 0.501F;
    const struct {
        const char *name, *sampleType;
        OIIO::TypeDesc type;
        int bits;
        float tolerance;  // for values from 0 to 1
    } kCases[] = {
        {"f.exr", "", OIIO::TypeFloat, 32, 0.0F},
        {"h.exr", "half", OIIO::TypeHalf, 16, 0x1p-12F},
        {"f.tif", "", OIIO::TypeFloat, 32, 0.0F},
        {"10.tif", "uint10", OIIO::TypeUInt16, 10, kHalfCode / 1023},
        {"f.png", "", OIIO::TypeUInt16, 16, kHalfCode / 65535},
        {"8.png", "uint8", OIIO::TypeUInt8, 8, kHalfCode / 255},
        {"f.dpx", "", OIIO::TypeUInt16, 16, kHalfCode / 65535},
        {"10.dpx", "uint10", OIIO::TypeUInt16, 10, kHalfCode / 1023},
        {"12.dpx", "uint12", OIIO::TypeUInt16, 12, kHalfCode / 4095},
        {"f.ppm", "", OIIO::TypeUInt8, 8, kHalfCode / 255},
        {"f.tga", "", OIIO::TypeUInt8, 8, kHalfCode / 255},
        {"f.hdr", "", OIIO::TypeFloat, 32, 1.0F / 128},  // shared exponent
        {"f.jpg", "", OIIO::TypeUInt8, 8, 0.05F},
    };
    host::Node& pattern = host_.createNode("CMSTestPattern");
    pattern.setValue("size", "6");
    for (const auto& each : kCases) {
        SCOPED_TRACE(each.name);
        const std::string path = folder_.path(each.name);
        host::writeImage(path, *pattern.image(), each.sampleType);
        const OIIO::ImageSpec spec = OIIO::ImageInput::open(path)->spec();
        EXPECT_EQ(spec.format, each.type);
        EXPECT_EQ(spec.get_int_attribute("oiio:BitsPerSample", each.bits), each.bits);

        host::ImageFile image(path);
        const zefra::Box& box = image.box();
        ASSERT_EQ(box.width(), pattern.image()->box().width());
        ASSERT_EQ(box.height(), pattern.image()->box().height());
        for (int y = 3; y < box.t; y += 7) {
            zefra::Row expected(0, box.r);
            zefra::Row found(0, box.r);
            expected.get(*pattern.image(), y, 0, box.r, zefra::kRGB);
            image.copyRow(y, 0, box.r, zefra::kRGB, found);
            for (int x = 3; x < box.r; x += 7) {
                for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue})
                    ASSERT_NEAR(found.pixels(channel)[x], expected.pixels(channel)[x],
                                each.tolerance);
            }
        }

        const auto byteCount = std::filesystem::file_size(path);
        // TGA files end with a preview and a footer.
        const std::uintmax_t cut = std::string(each.name) == "f.tga" ? byteCount / 10 : 1;
        for (const std::uintmax_t kept :
             {byteCount - cut, byteCount * 9 / 10, byteCount / 2, byteCount / 10}) {
            std::filesystem::resize_file(path, kept);
            const std::string failure = failureOf([&] { readRow(path); });
            EXPECT_EQ(failure.find(path + ": "), 0U) << kept << " bytes: " << failure;
            EXPECT_EQ(failure.find('\n'), std::string::npos);
        }
    }
    const std::string path = folder_.path("other.png");
    EXPECT_EQ(failureOf([&] { host::writeImage(path, *pattern.image(), "half"); }),
              path + ": .png files hold uint8, uint16, not half");
    EXPECT_FALSE(std::filesystem::exists(path));
}

/// An image that fails in the middle.
class FailingImage final : public zefra::Iop {
public:
    using Iop::Iop;
    const char* className() const override { return "FailingImage"; }
    const char* help() const override { return ""; }

protected:
    void _validate(bool) override { setBox({0, 0, 10, 10}); }
    void engine(int y, int, int, zefra::ChannelMask, zefra::Row&) override {
        if (y == 5) throw host::Error("row 5 fails");
    }
};

TEST_F(ImageFileTest, LeavesNothingBehindWhenWritingFails) {
    host::Node& node = host_.createNode("CMSTestPattern");
    FailingImage failing(node);
    const std::string path = folder_.path("failing.exr");
    EXPECT_EQ(failureOf([&] { host::writeImage(path, failing); }), "row 5 fails");
    EXPECT_FALSE(std::filesystem::exists(path));

    host::Host::requestCancel();
    EXPECT_EQ(failureOf([&] { host::writeImage(path, *node.image()); }), path + ": cancelled");
    EXPECT_FALSE(std::filesystem::exists(path));
    host::Host::clearCancel();

    for (const char* const name : {"pattern.xyz", "pattern.ico", "pattern.null", "pattern.term"}) {
        const std::string unknown = folder_.path(name);
        EXPECT_NE(failureOf([&] { host::writeImage(unknown, *node.image()); }), "");
        EXPECT_FALSE(std::filesystem::exists(unknown));
    }
}

#ifdef __linux__
TEST_F(ImageFileTest, NoticesAFullDisk) {
    host::Node& pattern = host_.createNode("CMSTestPattern");
    for (const char* const name : {"full.exr", "full.tif", "full.png", "full.jpg"}) {
        const std::string path = folder_.path(name);
        std::filesystem::create_symlink("/dev/full", path);
        const std::string failure = failureOf([&] { host::writeImage(path, *pattern.image()); });
        EXPECT_EQ(failure.find(path + ": "), 0U) << failure;
    }
}
#endif

TEST_F(ImageFileTest, ReadNodeFollowsItsFile) {
    const std::string path = folder_.path("changing.exr");
    host::Node& read = host_.createNode("Read");
    EXPECT_EQ(failureOf([&] { read.image()->validate(true); }), "Read: no image file is set");
    read.setValue("file", path);
    for (const char* const size : {"2", "3"}) {
        host::Node& pattern = host_.createNode("CMSTestPattern");
        pattern.setValue("size", size);
        host::writeImage(path, *pattern.image());
        read.image()->validate(true);
        EXPECT_EQ(read.image()->box().width(), pattern.image()->box().width());
        zefra::Row row(0, 14);
        row.get(*read.image(), 0, 0, 14, zefra::kRGB);
        EXPECT_EQ(row.pixels(zefra::kRed)[7], size[0] == '2' ? 1.0F : 0.5F);
    }
}

}  // namespace
