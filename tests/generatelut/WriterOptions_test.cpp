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

    std::string text(const char* name) const {
        const auto found = properties().find(name);
        return found ? found->toString() : "none";
    }
    /// All digits of it, which a property's text does not have.
    double number(const char* name) const {
        const auto found = properties().find(name);
        const auto* const value = property::asDouble(found.get(), 1);
        return value == nullptr ? 0.0 : value->values[0];
    }
};

TEST(WriterOptions, AreThoseOfTheMenus) {
    const struct {
        generatelut::Options3DL options;
        const char* texts;  // input bits, output bits, whether to clamp, format, scale and offset
    } kCases[] = {
        {{2, 0, true, 0}, "10 10 1 flame none none"},
        {{0, 0, true, 1}, "4 4 1 lustre none none"},
        {{1, 0, false, 2}, "8 8 0 scratch 0.979798 15"},
        {{3, 1, true, 0}, "12 4 1 flame none none"},
        {{4, 2, true, 0}, "16 8 1 flame none none"},
        {{0, 3, true, 0}, "4 10 1 flame none none"},
        {{0, 4, true, 0}, "4 12 1 flame none none"},
        {{0, 5, true, 0}, "4 16 1 flame none none"},
        // What only scripts set: the dialect that the writer refuses, and the nearest bit depth.
        {{2, 0, true, 3}, "10 10 1 auto none none"},
        {{2, 0, true, -1}, "10 10 1 auto none none"},
        {{99, 0, true, 0}, "16 16 1 flame none none"},
        {{-5, 99, true, 0}, "4 16 1 flame none none"},
        {{2, -1, true, 0}, "10 4 1 flame none none"},
        {{2, std::numeric_limits<int>::min(), true, 0}, "10 4 1 flame none none"},
    };
    for (const auto& [options, texts] : kCases) {
        OpenWriter writer;
        generatelut::setWriterOptions(writer, options);
        std::string found;
        for (const char* const name :
             {"inputBitDepth", "outputBitDepth", "clampOutput", "format3DL", "scale", "offset"})
            found += (found.empty() ? "" : " ") + writer.text(name);
        EXPECT_EQ(found, texts);
        if (options.format == 2) {
            EXPECT_EQ(writer.number("scale"), 0.9797979593276978);  // 97/99 in single precision
        }
    }
}

}  // namespace
