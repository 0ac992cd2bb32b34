// What readers have in common: one row a format, read by what the registry gives for its extension.
// What a format has for itself is in the file of its reader.

#include <gtest/gtest.h>
#include <sys/resource.h>

#include <cstdint>
#include <filesystem>
#include <stdexcept>

#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/GermanLocale.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

struct TextFormat {
    const char* extension;
    const char* sample;  // under tests/data: a marked lattice
    int width, height, depth;
    std::uint64_t lineCount;   // up to the last sample
    const char* lastSample;    // its line
    float codeMax;             // of integer codes; 1 where the file holds the samples themselves
    bool startsOver;           // a surplus sample replaces the first; otherwise it is not read
    const char* missingError;  // null: a missing sample stays zero
    const char* dataError;     // for a line of two or four numbers; null: such a line is taken
    const char* emptyError;
    const char* openError;
    const char* tooLarge;  // a file with more points than can be numbered
};

constexpr char k3DLData[] = "3DL file reader: syntax error while reading LUT data";
constexpr char kCMSData[] = "CMS LUT reader: syntax error while reading LUT data.";
constexpr char kCSPMissing[] =
    "CSP LUT reader: syntax error while reading 3D LUT data, expecting more data.";
constexpr char kCubData[] =
    "Truelight LUT reader: syntax error while reading LUT data (too many or not enough values).";
constexpr char kCubEmpty[] = "Truelight LUT reader: syntax error while reading LUT data.";
constexpr char kCubeData[] = "Iridas LUT reader: syntax error while reading LUT data.";
constexpr char kVFData[] = "VF file reader: syntax error while reading LUT data.";

const TextFormat kFormats[] = {
    {".3dl", "3dl/flame.3dl", 2, 2, 2, 13, "111 1111 2111", 4095.0F, false, nullptr, k3DLData,
     "3DL file reader: syntax error while reading LUT size", "3DL file reader: unable to open file",
     nullptr},
    {".cms", "cms/lattice.cms", 2, 2, 2, 20, "\t0.0111\t.1111   0.2111  ", 1.0F, true, nullptr,
     kCMSData, "CMS LUT reader: failed to read LUT file.", "CMS LUT reader: unable to open file.",
     "LUT_3D_SIZE 1291\n"},
    {".csp", "csp/lattice.csp", 2, 3, 4, 46, "0.0321 0.1321 0.2321", 1.0F, false, kCSPMissing,
     nullptr, "CSP LUT reader: expecting version identifier CSPLUTV100.",
     "CSP LUT reader: unable to open file.",
     "CSPLUTV100\n3D\n1\n0\n0\n1\n0\n0\n1\n0\n0\n1291 1291 1291\n"},
    {".cub", "cub/lattice.cub", 2, 3, 4, 30, "0.0321 0.1321 0.2321", 1.0F, true, nullptr, kCubData,
     kCubEmpty, "Truelight LUT reader: unable to open file.", "# width 1291 1291 1291\n"},
    {".cube", "cube/lattice.cube", 2, 2, 2, 14, "\t0.0111\t.1111   0.2111  ", 1.0F, true, nullptr,
     kCubeData, "Iridas LUT reader: LUT failed to initialise.",
     "Iridas LUT reader: unable to open file.", "LUT_3D_SIZE 1291\n"},
    {".vf", "vf/lattice.vf", 2, 3, 4, 31, "0.0321 0.1321 0.2321", 1.0F, false, kVFData, kVFData,
     "VF file reader: expecting #Inventor V2.1 ascii header line.",
     "VF file reader: unable to open file.",
     "#Inventor V2.1 ascii\n\nparameters\ngrid_size 1291 1291 1291\n"},
};

class TextFormatTest : public testing::TestWithParam<TextFormat> {
protected:
    TextFormatTest() { Reading3DL()(*reader_); }

    boost::shared_ptr<ol::LUT> read(const std::string& bytes) {
        return reader_->read(folder_.write("table", bytes));
    }
    std::string withLast(const std::string& line) const {
        return replaced(sample_, format_.lastSample, line);
    }
    const ol::RGB& last(const ol::LUT& lut) const {
        return lut.get(format_.width - 1, format_.height - 1, format_.depth - 1);
    }

    const TextFormat format_ = GetParam();
    const std::uint64_t sampleCount_ =
        static_cast<std::uint64_t>(format_.width * format_.height * format_.depth);
    const float divisor_ = format_.codeMax == 1.0F ? 10000.0F : format_.codeMax;
    const std::string sample_ = readFile(dataPath(format_.sample));
    const boost::shared_ptr<ol::LUTFileReader> reader_ =
        ol::createReader("", true, format_.extension);
    const TempFolder folder_;
};

TEST_P(TextFormatTest, PutsEachSampleAtItsPlaceHoweverOftenItIsRead) {
    const auto expected = markedLattice(format_.width, format_.height, format_.depth, divisor_);
    ol::setUnitDomain(*expected, format_.width, format_.height, format_.depth);
    const auto first = read(sample_);
    if (format_.extension != std::string(".vf")) {  // which says itself where it lies
        EXPECT_EQ(first->transform, expected->transform);
    }
    EXPECT_EQ(reader_->lineNumber(), format_.lineCount);
    EXPECT_EQ(reader_->sampleCount(), sampleCount_);
    EXPECT_EQ(messageOf([&] { read(""); }), format_.emptyError);
    EXPECT_EQ(reader_->lineNumber(), 0U);
    EXPECT_EQ(reader_->sampleCount(), 0U);
    const auto second = read(sample_);
    EXPECT_EQ(reader_->sampleCount(), sampleCount_);
    EXPECT_NE(first, second);
    expectSamplesNear(*first, *expected, 0.0F);
    expectSamplesNear(*second, *expected, 0.0F);
}

TEST_P(TextFormatTest, KnowsWhatToDoWithTooFewAndTooManySamples) {
    boost::shared_ptr<ol::LUT> lut;
    const std::string shortened = replaced(sample_, std::string(format_.lastSample) + "\n", "");
    const std::string message = messageOf([&] { lut = read(shortened); });
    if (format_.missingError != nullptr) {
        EXPECT_EQ(message, format_.missingError);
    } else {
        ASSERT_EQ(message, "(no exception)");
        expectRGB(last(*lut), 0.0F, 0.0F, 0.0F);
    }
    EXPECT_EQ(reader_->sampleCount(), sampleCount_ - 1);

    lut = read(withLast(std::string(format_.lastSample) + "\n7 8 9"));
    expectRGB(lut->get(0, 0, 0),
              format_.startsOver ? ol::RGB(7.0F, 8.0F, 9.0F) : markedSample(0, 0, 0, divisor_));
    EXPECT_EQ(reader_->sampleCount(), sampleCount_ + (format_.startsOver ? 1 : 0));
}

TEST_P(TextFormatTest, RefusesALineOfTwoOrFourNumbersAndTellsItsPlace) {
    for (const char* const line : {"1 2", "1 2 3 4"}) {
        const std::string message = messageOf([&] { read(withLast(line)); });
        if (format_.dataError == nullptr) {
            EXPECT_EQ(message, "(no exception)");
            continue;
        }
        EXPECT_EQ(message, format_.dataError);
        EXPECT_EQ(reader_->lineNumber(), format_.lineCount);
        EXPECT_EQ(reader_->sampleCount(), sampleCount_ - 1);
    }
}

TEST_P(TextFormatTest, ReadsNumbersAsTheCConversionsDoInEveryLocale) {
    const auto expectConverted = [&] {
        const auto lut = read(withLast("+1.5 0x1.8p1 none\r"));  // none of them plain
        expectRGB(last(*lut), 1.5F / format_.codeMax, 3.0F / format_.codeMax, 0.0F);
        expectSamplesNear(*read(sample_),
                          *markedLattice(format_.width, format_.height, format_.depth, divisor_),
                          0.0F);
    };
    expectConverted();
    const GermanLocale locale;
    expectConverted();
}

TEST_P(TextFormatTest, BelievesNoSizeAndNoName) {
    if (format_.tooLarge != nullptr) {
        EXPECT_THROW(read(format_.tooLarge), std::length_error);
    }
    EXPECT_EQ(messageOf([&] { reader_->read(folder_.path("none")); }), format_.openError);
}

std::string nameOf(const testing::TestParamInfo<TextFormat>& info) {
    return info.param.extension + 1;
}
INSTANTIATE_TEST_SUITE_P(Formats, TextFormatTest, testing::ValuesIn(kFormats), nameOf);

/// Expects a table, an Exception or the standard library's length error.
void expectSafe(ol::LUTFileReader& reader, const std::string& file) {
    try {
        EXPECT_TRUE(reader.read(file));
    } catch (const ol::Exception& exception) {
        EXPECT_STRNE(exception.message(), "");
    } catch (const std::length_error&) {
    }
}

// Under the address sanitizer, without reading or writing outside an array.
TEST(EveryFormat, SurvivesEveryTruncationOfItsSamples) {
    const TempFolder folder;
    testing::internal::CaptureStderr();
    int fileCount = 0;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(dataPath(""))) {
        const std::string extension = entry.path().extension().string();
        if (!entry.is_regular_file() || extension == ".md" || extension == ".txt") continue;
        SCOPED_TRACE(entry.path());
        ++fileCount;
        const auto byFile = ol::createReader("", true, extension);
        const auto asLustre = ol::createReader("", true, extension);
        Reading3DL()(*byFile);
        Reading3DL{"lustre", -1, 1}(*asLustre);
        const std::string file = folder.write("cut", readFile(entry.path().string()));
        for (std::uintmax_t byteCount = entry.file_size(); byteCount-- > 0;) {
            std::filesystem::resize_file(file, byteCount);
            expectSafe(*byFile, file);
            expectSafe(*asLustre, file);
        }
    }
    testing::internal::GetCapturedStderr();
    EXPECT_GE(fileCount, 20);
}

/// Most memory that this process has had resident so far.
std::int64_t peakMebibytes() {
    rusage usage{};
    getrusage(RUSAGE_SELF, &usage);
#ifdef __APPLE__
    return usage.ru_maxrss >> 20;  // given in bytes
#else
    return usage.ru_maxrss >> 10;
#endif
}

// Each table would be 1.4 GiB, if the samples that the file does not hold were touched.
TEST(EveryFormat, CostsNoMemoryForWhatAFileOnlyClaims) {
    std::string grid;
    for (int i = 0; i < 500; ++i)
        grid += std::to_string(i * 65535 / 499) + " ";
    const std::string cub = "# width 500 500 500\n1 1 1\n# width 500 500 499\n1 1 1\n";
    const std::string csp = "CSPLUTV100\n3D\n1\n0\n0\n1\n0\n0\n1\n0\n0\n";
    const std::string vf = "#Inventor V2.1 ascii\n\nparameters\n";
    const struct {
        const char* extension;
        std::string text;
        const char* message = "(no exception)";
    } kFiles[] = {
        {".3dl", grid + "\n1 2 3\n"},  // of 4 bits, which is known at the end
        {".cms", "LUT_3D_SIZE 500\n"},
        {".csp", csp + "500 500 500\n0 0 0\n", kCSPMissing},
        {".csp", csp + "2147483647 0 2147483647\n"},
        {".cub", cub + cub + cub + cub},
        {".cube", "LUT_3D_SIZE 500\n1 1 1\n"},
        {".vf", vf + "grid_size 500 500 500\ngrid_size 500 500 499\ndata\n", kVFData},
        {".vf", vf + "grid_size 0 2147483647 2147483647\n"},
    };
    const std::int64_t before = peakMebibytes();
    for (const auto& [extension, text, message] : kFiles) {
        EXPECT_EQ(messageOf([&, e = extension, &t = text] { readBytes(e, t); }), message);
        EXPECT_LT(peakMebibytes() - before, 64) << extension;
    }
}

}  // namespace
