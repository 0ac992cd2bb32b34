#include "generatelut/WriterOptions.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

namespace {

namespace property = Orlith::Property;

/// A writer that lets its properties be seen.
class OpenWriter final : public Orlith::LUT::LUTFileWriter {
public:
    void write(const std::string&, const boost::shared_ptr<Orlith::LUT::LUT>&) override {}

    int integer(const char* name) const {
        const auto found = properties().find(name);
        const auto* const value = property::asInt(found.get(), 1);
        return value == nullptr ? -999 : value->values[0];
    }
    double number(const char* name) const {
        const auto found = properties().find(name);
        const auto* const value = property::asDouble(found.get(), 1);
        return value == nullptr ? -999.0 : value->values[0];
    }
    std::string text(const char* name) const {
        const auto found = properties().find(name);
        const auto* const value = property::asString(found.get(), 1);
        return value == nullptr ? "(none)" : value->values[0];
    }
};

TEST(WriterOptions, AreThoseOfTheMenus) {
    const struct {
        int bitDepth, outputBitDepth;
        bool clamps;
        int format;
        int inputBits, outputBits;
        const char* formatName;
        double scale, offset;
    } kCases[] = {
        {2, 0, true, 0, 10, 10, "flame", -999.0, -999.0},
        {0, 0, true, 1, 4, 4, "lustre", -999.0, -999.0},
        {1, 0, false, 2, 8, 8, "scratch", 0.9797979593276978, 15.0},
        {3, 1, true, 0, 12, 4, "flame", -999.0, -999.0},
        {4, 2, true, 0, 16, 8, "flame", -999.0, -999.0},
        {0, 3, true, 0, 4, 10, "flame", -999.0, -999.0},
        {0, 4, true, 0, 4, 12, "flame", -999.0, -999.0},
        {0, 5, true, 0, 4, 16, "flame", -999.0, -999.0},
        // What only scripts set: the dialect that the writer refuses, and the nearest bit depth.
        {2, 0, true, 3, 10, 10, "auto", -999.0, -999.0},
        {2, 0, true, 2147483647, 10, 10, "auto", -999.0, -999.0},
        {2, 0, true, -1, 10, 10, "auto", -999.0, -999.0},
        {99, 0, true, 0, 16, 16, "flame", -999.0, -999.0},
        {-5, 99, true, 0, 4, 16, "flame", -999.0, -999.0},
        {2, -1, true, 0, 10, 4, "flame", -999.0, -999.0},
        {2, std::numeric_limits<int>::min(), true, 0, 10, 4, "flame", -999.0, -999.0},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::to_string(each.bitDepth) + " " + std::to_string(each.outputBitDepth) +
                     " " + std::to_string(each.format));
        OpenWriter writer;
        generatelut::setWriterOptions(
            writer, {each.bitDepth, each.outputBitDepth, each.clamps, each.format});
        EXPECT_EQ(writer.integer("inputBitDepth"), each.inputBits);
        EXPECT_EQ(writer.integer("outputBitDepth"), each.outputBits);
        EXPECT_EQ(writer.integer("clampOutput"), each.clamps ? 1 : 0);
        EXPECT_EQ(writer.text("format3DL"), each.formatName);
        EXPECT_EQ(writer.number("scale"), each.scale);
        EXPECT_EQ(writer.number("offset"), each.offset);
    }
}

}  // namespace
