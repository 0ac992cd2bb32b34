#include "lut/io/LUTFileReaderVF.h"

#include <gtest/gtest.h>

#include <limits>
#include <stdexcept>

#include "tests/support/Files.h"
#include "tests/support/Gzip.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr char kHeaderError[] = "VF file reader: expecting #Inventor V2.1 ascii header line.";
constexpr char kGridError[] = "VF file reader: expecting 3 values for grid_size.";
constexpr char kElementError[] = "VF file reader: expecting 3 values for element_size.";
constexpr char kOriginError[] = "VF file reader: expecting 3 values for world_origin.";
constexpr char kTransformError[] = "VF file reader: expecting 16 more tokens.";
constexpr char kDataError[] = "VF file reader: syntax error while reading LUT data.";

constexpr char kStart[] = "#Inventor V2.1 ascii\nSoVectorField {\nparameters\n";

/// A file with these parameter lines and one sample.
std::string field(const std::string& parameters) {
    return kStart + ("grid_size 1 1 1\n" + parameters) + "data\n.5 .25 .125\n}\n";
}

ol::Transform transformOf(const std::string& parameters) {
    return readBytes(".vf", field(parameters))->transform;
}

/// Scale on the diagonal, translation in the last row.
ol::Transform placed(float scale, float r, float g, float b) {
    const float elements[] = {scale, 0, 0, 0, 0, scale, 0, 0, 0, 0, scale, 0, r, g, b, 1};
    return ol::Transform(elements);
}

TEST(VFReader, PutsBlueFastestWhetherCompressedOrNot) {
    const std::string plain = readFile(dataPath("vf/lattice.vf"));
    const std::string compressed = readFile(dataPath("vf/lattice.vfz"));
    ASSERT_EQ(compressed.substr(0, 2), "\x1F\x8B");
    for (const std::string& bytes : {plain, compressed, gzip(plain, {"x", "a.vf", "b", true})}) {
        for (const char* const extension : {".vf", ".vfz", ".gz"}) {
            const auto lut = readBytes(extension, bytes);
            expectSamplesNear(*lut, *markedLattice(2, 3, 4), 0.0F);
            EXPECT_EQ(lut->transform, placed(0.5F, 0.1F, 0.2F, 0.3F));
        }
    }
}

TEST(VFReader, PlacesTheGridByElementSizeAndOriginUnlessThereIsAGlobalTransform) {
    const std::string matrix = "1 2 3 4 5 6 7 8 9 10 11 12 13 14 15 16";
    const std::string identity = "1 0 0 0 0 1 0 0 0 0 1 0 0 0 0 1";
    const std::string both = "element_size .5 .5 .5\nworld_origin .1 .2 .3\n";
    const ol::Transform grid = placed(0.5F, 0.1F, 0.2F, 0.3F);
    EXPECT_EQ(transformOf(both), grid);
    EXPECT_EQ(transformOf("world_origin .1 .2 .3\n"), placed(1.0F, 0.1F, 0.2F, 0.3F));
    EXPECT_EQ(transformOf("element_size 9 9 9\n" + both), grid);  // the last one counts
    EXPECT_EQ(transformOf(both + "global_transform " + identity + "\n"), grid);
    const ol::Transform nearIdentity =
        transformOf(both + "global_transform " +
                    replaced(identity, "1 0 0 0 0 1 0", "1 0 0 0 0 1 1e-30") + "\n");
    EXPECT_EQ(nearIdentity[0][0], 1.0F);
    EXPECT_EQ(nearIdentity[1][2], 1e-30F);

    const ol::Transform global = transformOf("\t global_transform\t" + matrix + " \r\n" + both);
    for (unsigned i = 0; i < 16; ++i)
        EXPECT_EQ(global[i / 4][i % 4], static_cast<float>(i + 1));

    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    EXPECT_EQ(transformOf("element_size inf inf inf\nworld_origin inf 0 -inf\n"),
              placed(kInfinity, kInfinity, 0.0F, -kInfinity));
}

TEST(VFReader, ReadsNumbersAndLinesLeniently) {
    const auto lut = readBytes(".vf",
                               " \t#Inventor V2.1 ascii \r\n"
                               "anything\n"
                               " parameters\r\n"
                               "\n"
                               "colour_space unknown\n"
                               "grid_size 9 9 9\n"
                               "grid_size 1x 1.9 +2\n"
                               "  data\t\n"
                               "\t+1e1 0x10  none\n"
                               "1 2 3\r\n"
                               "not read");
    ASSERT_EQ(lut->width(), 1);
    ASSERT_EQ(lut->height(), 1);
    ASSERT_EQ(lut->depth(), 2);
    expectRGB(lut->get(0, 0, 0), 10.0F, 16.0F, 0.0F);
    expectRGB(lut->get(0, 0, 1), 1.0F, 2.0F, 3.0F);
}

TEST(VFReader, RefusesWhatIsNoVectorField) {
    expectRefused(".vf",
                  field("element_size 1 1 1\nworld_origin 0 0 0\n"
                        "global_transform 2 0 0 0 0 2 0 0 0 0 2 0 0 0 0 1\n"),
                  {{"other version", "V2.1", "V2.0", kHeaderError},
                   {"binary", "ascii", "binary", kHeaderError},
                   {"blank line before", "#Inv", "\n#Inv", kHeaderError},
                   {"two sizes", "grid_size 1 1 1", "grid_size 1 1", kGridError},
                   {"four sizes", "grid_size 1 1 1", "grid_size 1 1 1 1", kGridError},
                   {"two elements", "element_size 1 1 1", "element_size 1 1", kElementError},
                   {"four elements", "element_size 1", "element_size 1 1", kElementError},
                   {"two origins", "world_origin 0 0 0", "world_origin 0 0", kOriginError},
                   {"four origins", "world_origin 0", "world_origin 0 0", kOriginError},
                   {"fifteen elements", "transform 2 0", "transform 2", kTransformError},
                   {"seventeen elements", "transform 2", "transform 2 0", kTransformError},
                   {"no data line", "data\n", "", kDataError},
                   {"word after data", "data\n", "data 1\n", kDataError},
                   {"blank line in the data", ".5 .25", "\n.5 .25", kDataError},
                   {"data missing", ".5 .25 .125\n}\n", "", kDataError}});
}

TEST(VFReader, GivesAnEmptyTableWithoutAGrid) {
    for (const char* const bytes : {"#Inventor V2.1 ascii", "#Inventor V2.1 ascii\n\n",
                                    "#Inventor V2.1 ascii\nparameters\ngrid_size 1 1 1\ndata\n"}) {
        const auto lut = readBytes(".vf", bytes);
        EXPECT_EQ(lut->width(), 0);
        EXPECT_EQ(lut->data(), nullptr);
    }
}

TEST(VFReader, RefusesSizesThatCannotBe) {
    for (const char* const size : {"2147483647 2 1", "-1 1 1", "0 1 -1"}) {
        EXPECT_THROW(readBytes(".vf", kStart + ("grid_size " + std::string(size))),
                     std::length_error);
    }
}

TEST(VFReader, CutsAnEnormousLineOfASmallFile) {
    // Uncut, the line would be a parameter to skip and the sample behind it would be read.
    const std::string line = "note " + std::string(std::size_t{64} << 20, ' ') + "\n";
    const std::string bytes = gzip(field(line));
    ASSERT_LT(bytes.size(), std::size_t{1} << 20);
    EXPECT_EQ(messageOf([&] { readBytes(".vfz", bytes); }), kDataError);
}

TEST(VFReader, EndsCompressedDataAtAFault) {
    std::string bytes = gzip(readFile(dataPath("vf/lattice.vf")));
    const std::string good = bytes;
    bytes[10] = '\x07';  // first deflate block: of no known type
    EXPECT_EQ(messageOf([&] { readBytes(".gz", bytes); }), kHeaderError);
    EXPECT_EQ(messageOf([&] { readBytes(".gz", good.substr(0, good.size() / 2)); }), kDataError);
}

}  // namespace
