#include "host/ImageFile.h"

#include <OpenImageIO/imageio.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <filesystem>
#include <ostream>
#include <string>
#include <vector>

#include "tests/host/HostFixture.h"

namespace {

using test::failureOf;

/// The value that tells a sample's place in the file: column, line counted downward, channel.
float mark(int column, int line, int channel) {
    return static_cast<float>(column + 10 * line + 100 * channel);
}

OIIO::ImageSpec markedSpec(const std::vector<std::string>& channels) {
    OIIO::ImageSpec spec(4, 3, static_cast<int>(channels.size()), OIIO::TypeFloat);
    spec.channelnames = channels;
    return spec;
}

/// Writes an image whose samples tell their places.
void writeMarked(const std::string& path, const OIIO::ImageSpec& spec) {
    std::vector<float> samples;
    for (int line = 0; line < spec.height; ++line) {
        for (int column = 0; column < spec.width; ++column) {
            for (int channel = 0; channel < spec.nchannels; ++channel)
                samples.push_back(mark(column, line, channel));
        }
    }
    const auto output = OIIO::ImageOutput::create(path);
    ASSERT_TRUE(output && output->open(path, spec) &&
                output->write_image(OIIO::TypeFloat, samples.data()) && output->close())
        << path;
}

/// Expects row y of a file, from column x on, to hold one line of the marked image.
void expectLine(host::ImageFile& image, int y, int x, int line, int red, int green, int blue) {
    zefra::Row row(x, x + 4);
    image.copyRow(y, x, x + 4, zefra::kRGB, row);
    for (int column = 0; column < 4; ++column) {
        EXPECT_EQ(row.pixels(zefra::kRed)[column], mark(column, line, red));
        EXPECT_EQ(row.pixels(zefra::kGreen)[column], mark(column, line, green));
        EXPECT_EQ(row.pixels(zefra::kBlue)[column], mark(column, line, blue));
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
    writeMarked(path, markedSpec({"R", "G", "B"}));
    host::ImageFile image(path);
    EXPECT_EQ(image.box().width(), 4);
    EXPECT_EQ(image.box().height(), 3);
    for (int y = 0; y < 3; ++y)
        expectLine(image, y, 0, 2 - y, 0, 1, 2);
}

TEST_F(ImageFileTest, TakesChannelsByNameOrElseTheFirstThree) {
    const struct {
        std::vector<std::string> names;
        int red, green, blue;
    } kCases[] = {
        {{"B", "G", "R"}, 2, 1, 0},          {{"alpha", "red", "Green", "BLUE"}, 1, 2, 3},
        {{"g", "depth", "r", "b"}, 2, 0, 3}, {{"R", "G", "Y", "B"}, 0, 1, 3},
        {{"u", "v", "w"}, 0, 1, 2},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(each.names[0]);
        const std::string path = folder_.path("channels.exr");
        writeMarked(path, markedSpec(each.names));
        host::ImageFile image(path);
        expectLine(image, 1, 0, 1, each.red, each.green, each.blue);
    }
}

TEST_F(ImageFileTest, KeepsTheDataWindowWhereTheFileHasIt) {
    const std::string path = folder_.path("window.exr");
    OIIO::ImageSpec spec = markedSpec({"R", "G", "B"});
    spec.x = 5;  // within a display window of 20 x 10 from (0, 0)
    spec.y = 2;
    spec.full_width = 20;
    spec.full_height = 10;
    writeMarked(path, spec);

    host::ImageFile image(path);
    EXPECT_EQ(image.box().x, 5);
    EXPECT_EQ(image.box().r, 9);
    EXPECT_EQ(image.box().y, 5);  // 10 - (2 + 3)
    EXPECT_EQ(image.box().t, 8);
    expectLine(image, 5, 5, 2, 0, 1, 2);

    // Around the box there is black, in front of it, behind it, above it.
    zefra::Row row(-2, 12);
    image.copyRow(7, -2, 12, zefra::kRGB, row);
    const float* const green = row.pixels(zefra::kGreen) + 2;
    EXPECT_EQ(green[4], 0.0F);
    EXPECT_EQ(green[5], mark(0, 0, 1));
    EXPECT_EQ(green[8], mark(3, 0, 1));
    EXPECT_EQ(green[9], 0.0F);
    image.copyRow(8, -2, 12, zefra::kRGB, row);
    EXPECT_EQ(green[5], 0.0F);
}

TEST_F(ImageFileTest, SaysWhatIsWrongWithAFile) {
    const std::string one = folder_.path("one.exr");
    writeMarked(one, markedSpec({"Y"}));
    const std::string two = folder_.path("two.exr");
    writeMarked(two, markedSpec({"R", "G"}));
    const std::string text = folder_.write("text.exr", "not an image\n");
    const std::string empty = folder_.write("empty.png", "");
    // 53 bytes that claim 4,800,000,000 bytes of float pixels.
    const std::string bomb =
        folder_.write("bomb.hdr", "#?RADIANCE\nFORMAT=32-bit_rle_rgbe\n\n-Y 20000 +X 20000\n");
    const struct {
        std::string path, reason;
    } kCases[] = {
        {one, ": needs red, green and blue channels, has 1"},
        {two, ": needs red, green and blue channels, has 2"},
        {text, ": \"" + text + "\" is not an OpenEXR file"},
        {empty, ": Not a PNG file"},
        {bomb, ": claims 20000 x 20000 pixels in 53 bytes"},
        {folder_.path("missing.exr"), ": No such file or directory"},
        {folder_.path("."), ": is a folder"},
    };
    for (const auto& each : kCases)
        EXPECT_EQ(failureOf([&] { readRow(each.path); }), each.path + each.reason);
}

struct Format {
    const char* extension;
    float tolerance;  // for values from 0 to 1

    friend std::ostream& operator<<(std::ostream& out, const Format& format) {
        return out << format.extension;
    }
};
class ImageFormatTest : public ImageFileTest, public ::testing::WithParamInterface<Format> {};

TEST_P(ImageFormatTest, HoldsThePatternAndIsRefusedWhenCutOff) {
    const std::string path = folder_.path(std::string("pattern.") + GetParam().extension);
    host::Node& pattern = host_.createNode("CMSTestPattern");
    pattern.setValue("size", "5");
    host::writeImage(path, *pattern.image());

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
                            GetParam().tolerance);
        }
    }

    const auto byteCount = std::filesystem::file_size(path);
    for (const std::uintmax_t kept : {byteCount * 9 / 10, byteCount / 2, byteCount / 10}) {
        std::filesystem::resize_file(path, kept);
        const std::string failure = failureOf([&] { readRow(path); });
        EXPECT_EQ(failure.find(path + ": "), 0U) << kept << " bytes: " << failure;
        EXPECT_EQ(failure.find('\n'), std::string::npos);
    }
}

INSTANTIATE_TEST_SUITE_P(Formats, ImageFormatTest,
                         ::testing::Values(Format{"exr", 0.0F}, Format{"tif", 0.0F},
                                           Format{"png", 0.5F / 65535.0F},
                                           Format{"dpx", 0.5F / 65535.0F},
                                           Format{"ppm", 0.51F / 255.0F},
                                           Format{"hdr", 1.0F / 128.0F},  // shared exponent
                                           Format{"jpg", 0.05F}),
                         [](const auto& each) { return std::string(each.param.extension); });

TEST_F(ImageFileTest, WritesFloatIntoTheFormatsThatHoldIt) {
    host::Node& pattern = host_.createNode("CMSTestPattern");
    pattern.setValue("size", "4");
    for (const char* const name : {"float.exr", "float.tif"}) {
        host::writeImage(folder_.path(name), *pattern.image());
        host::ImageFile image(folder_.path(name));
        zefra::Row row(0, 14);
        image.copyRow(0, 0, 14, zefra::kRGB, row);
        EXPECT_EQ(row.pixels(zefra::kRed)[7], 1.0F / 3.0F) << name;
    }
    const auto input = OIIO::ImageInput::open(folder_.path("float.tif"));
    EXPECT_EQ(input->spec().format, OIIO::TypeFloat);
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

    const std::string nowhere = folder_.path("no/such/folder.exr");
    EXPECT_EQ(failureOf([&] { host::writeImage(nowhere, *node.image()); }),
              nowhere + ": No such file or directory");
    const std::string unknown = folder_.path("pattern.xyz");
    EXPECT_NE(failureOf([&] { host::writeImage(unknown, *node.image()); }), "");
    EXPECT_FALSE(std::filesystem::exists(unknown));
}

#ifdef __linux__
TEST_F(ImageFileTest, NoticesAFullDisk) {
    host::Node& pattern = host_.createNode("CMSTestPattern");
    pattern.setValue("size", "9");
    for (const char* const name : {"full.exr", "full.tif", "full.png", "full.jpg"}) {
        const std::string path = folder_.path(name);
        std::filesystem::create_symlink("/dev/full", path);
        EXPECT_EQ(failureOf([&] { host::writeImage(path, *pattern.image()); }).find(path + ": "),
                  0U)
            << name;
        EXPECT_TRUE(std::filesystem::exists("/dev/full"));
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
