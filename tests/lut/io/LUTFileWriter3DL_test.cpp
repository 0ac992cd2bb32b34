#include "lut/io/LUTFileWriter3DL.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <limits>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"
#include "tests/support/ThreeDL.h"

namespace {

using namespace test;
namespace op = Orlith::Property;

/// The bytes of a file, and in warnings what the writer said meanwhile.
template <class Settings = Writing3DL>
std::string written(const Settings& settings, const boost::shared_ptr<ol::LUT>& lut,
                    std::string* warnings = nullptr) {
    ol::LUTFileWriter3DL writer;
    const TempFolder folder;
    settings(writer);
    testing::internal::CaptureStderr();
    writer.write(folder.path("out.3dl"), lut);
    const std::string said = testing::internal::GetCapturedStderr();
    if (warnings != nullptr) *warnings = said;
    return readFile(folder.path("out.3dl"));
}

void expectHolds(const std::string& file, const std::string& text) {
    EXPECT_NE(file.find(text), std::string::npos) << text << "is not in\n" << file.substr(0, 1000);
}

TEST(ThreeDLWriter, WritesEveryDepthInEveryDialect) {
    const struct {
        int bits;
        const char* grid;         // three points; the middle is a tie and goes to the even code
        int white, scratchWhite;  // 97/99 of the largest code, and 15
    } kCodes[] = {{4, "\n0 8 15 \n", 15, 15},
                  {8, "\n0 128 255 \n", 255, 255},
                  {10, "\n0 512 1023 \n", 1023, 1017},
                  {12, "\n0 2048 4095 \n", 4095, 4027},
                  {16, "\n0 32768 65535 \n", 65535, 64226}};
    const auto lut = markedLattice(3, 3, 3);
    lut->get(2, 2, 2) = ol::RGB(1.0F, 1.0F, 1.0F);
    for (const char* const format : {"flame", "lustre", "scratch"}) {
        for (const auto& input : kCodes) {
            for (const auto& output : kCodes) {
                const std::string file = written({format, input.bits, output.bits}, lut);
                expectHolds(file, "\n# Input bit depth " + std::to_string(input.bits) +
                                      "\n# Output bit depth " + std::to_string(output.bits) + "\n");
                expectHolds(file, input.grid);
                const int white = *format == 's' ? output.scratchWhite : output.white;
                expectHolds(file, " " + std::to_string(white) + "\n");
            }
        }
    }
}

TEST(ThreeDLWriter, WritesTheMeshOfEveryLustreCube) {
    for (int exponent = 0; exponent <= 6; ++exponent) {
        const int n = (1 << exponent) + 1;
        expectHolds(written({"lustre"}, markedLattice(n, n, n)),
                    "\n3DMESH\nMesh " + std::to_string(exponent) + " 12\n0 ");
    }
}

TEST(ThreeDLWriter, PutsTheGridOnEvenTiesAndTakesDepthsModulo32) {
    expectHolds(written({"flame"}, markedLattice(17, 17, 17)),
                "\n0 64 128 192 256 320 384 448 512 575 639 703 767 831 895 959 1023 \n");
    expectHolds(written({"flame", 32, 33}, markedLattice(2, 2, 2)), "\n0 0 \n0 0 0\n");
    expectHolds(written({"flame", 31, -1}, markedLattice(2, 2, 2)), "\n0 2147483647 \n0 ");
}

TEST(ThreeDLWriter, ClampsOnlyIfToldTo) {
    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
    const auto lut = markedLattice(2, 2, 2);
    lut->get(0, 0, 0) = ol::RGB(1.2F, -0.01F, 0.5F);  // 1227.6, -10.23 and 511.5, a tie
    lut->get(0, 0, 1) = ol::RGB(kInfinity, -kInfinity, kNaN);
    lut->get(0, 1, 0) = ol::RGB(1e30F, -1e30F, 510.5F / 1023.0F);
    expectHolds(written({"flame", 10, 10, 0}, lut),
                "\n1228 -10 512\n"
                "2147483647 -2147483648 0\n"
                "2147483647 -2147483648 510\n");
    expectHolds(written({"flame", 10, 10, 1}, lut), "\n1023 0 512\n1023 0 0\n1023 0 510\n");
    expectHolds(written({"flame", 10, 24, 1}, lut), "\n16777215 0 8388608\n16777215 0 0\n");
}

TEST(ThreeDLWriter, WarnsOfWhatTheProgramsDislike) {
    const std::string size =
        "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n";
    const std::string depth = " prefers 3DL files with input bit depth of at least 10\n";
    const std::string flameDepth = "Warning: Flame/Lustre" + depth;
    const std::string scratchDepth = "Warning: SCRATCH" + depth;
    const struct {
        Writing3DL settings;
        int pointsPerSide;
        std::string warnings;
    } kCases[] = {
        {{"flame", 10, 8}, 17, ""},
        {{"lustre", 12, 8}, 33, ""},
        {{"lustre", 8, 10}, 65, flameDepth},
        {{"lustre", 4, 10}, 9, size + flameDepth},
        {{"scratch", 10, 10}, 32, ""},
        {{"scratch", 8, 10},
         33,
         "Warning: SCRATCH prefers 3DL files of 32x32x32\n" + scratchDepth +
             "Warning: SCRATCH expects 3DL files with matching input/output bit depth\n"}};
    for (const auto& [settings, n, expected] : kCases) {
        SCOPED_TRACE(std::string(settings.format) + " of " + std::to_string(n));
        std::string warnings;
        EXPECT_NE(written(settings, markedLattice(n, n, n), &warnings), "");
        EXPECT_EQ(warnings, expected);
    }
}

TEST(ThreeDLWriter, RefusesInOrderBeforeAFileIsMade) {
    const TempFolder folder;
    const auto refusal = [&](ol::LUTFileWriter3DL& writer) {
        return messageOf([&] { writer.write(folder.path("no.3dl"), markedLattice(4, 4, 4)); });
    };
    for (const char* const format : {"auto", "Flame", ""}) {
        ol::LUTFileWriter3DL other;
        setProperty<op::String>(other, "format3DL", format);
        EXPECT_EQ(refusal(other), "3DL file reader: invalid 3DL format specified for writing");
    }
    ol::LUTFileWriter3DL writer;
    EXPECT_EQ(refusal(writer), "unable to find 3DL format to write");
    setProperty<op::String>(writer, "format3DL", "lustre");
    const char* const steps[][2] = {{"inputBitDepth", "unable to find input bitdepth to write"},
                                    {"outputBitDepth", "unable to find output bitdepth to write"},
                                    {"clampOutput", "unable to find clamp property"}};
    for (const auto& [name, message] : steps) {
        EXPECT_EQ(refusal(writer), message);
        setProperty<op::Int>(writer, name, 10);
    }
    testing::internal::CaptureStderr();
    EXPECT_EQ(refusal(writer), "Lustre 3DL cube resolution must be a power of two (plus one)");
    EXPECT_EQ(testing::internal::GetCapturedStderr(),
              "Warning: Flame/Lustre prefers 3DL files of 17x17x17, 33x33x33, 65x65x65\n");
    EXPECT_FALSE(std::filesystem::exists(folder.path("no.3dl")));
}

TEST(ThreeDLWriter, WarnsOfAScaleAndOffsetThatItCannotTake) {
    const auto settings = [](ol::LUTFileWriter3DL& writer) {
        setProperty<op::Int>(writer, "scale", 0);
        writer.setProperty("offset", boost::make_shared<op::Double>("offset", 2U));
        Writing3DL{"flame"}(writer);
    };
    std::string warnings;
    EXPECT_EQ(written(settings, markedLattice(2, 2, 2, 4095.0F), &warnings),
              readFile(dataPath("3dl/flame.3dl")));
    EXPECT_EQ(warnings.substr(0, warnings.find("Warning: Flame")),
              "Warning: 3DL scale is not a Double of one value, writing unscaled\n"
              "Warning: 3DL offset is not a Double of one value, writing without\n");
}

TEST(ThreeDLWriter, ReadsBackWithinHalfACode) {
    for (const std::string format : {"flame", "lustre", "scratch"}) {
        for (const int n : {2, 9, 33, 65}) {  // lattices are written in slices of eight reds
            SCOPED_TRACE(format + " " + std::to_string(n));
            const auto lut = markedLattice(n, n, n);
            const auto back =
                readBytes(".3dl", written({format.c_str(), 10, 16}, lut), Reading3DL());
            const float scale = format == "scratch" ? 0.97979796F : 1.0F;
            expectSamplesNear(*back, *lut, 0.5F / 65535.0F / scale + 1e-6F);
        }
    }
}

}  // namespace
