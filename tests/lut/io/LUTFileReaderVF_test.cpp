#include "lut/io/LUTFileReaderVF.h"

#include <gtest/gtest.h>

#include "tests/support/Files.h"
#include "tests/support/Gzip.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr char kHeaderError[] = "VF file reader: expecting #Inventor V2.1 ascii header line.";
constexpr char kDataError[] = "VF file reader: syntax error while reading LUT data.";

TEST(VFReader, PutsBlueFastestWhetherCompressedOrNot) {
    const std::string plain = readFile(dataPath("vf/lattice.vf"));
    const std::string compressed = readFile(dataPath("vf/lattice.vfz"));
    ASSERT_EQ(compressed.substr(0, 2), "\x1F\x8B");
    const float kPlaced[] = {0.5F, 0, 0, 0, 0, 0.5F, 0, 0, 0, 0, 0.5F, 0, 0.1F, 0.2F, 0.3F, 1};
    for (const std::string& bytes : {plain, compressed, gzip(plain, {"x", "a.vf", "b", true})}) {
        for (const char* const extension : {".vf", ".vfz", ".gz"}) {
            const auto lut = readBytes(extension, bytes);
            expectSamplesNear(*lut, *markedLattice(2, 3, 4), 0.0F);
            EXPECT_EQ(lut->transform, ol::Transform(kPlaced));
        }
    }
}

TEST(VFReader, EndsCompressedDataAtAFault) {
    std::string bytes = gzip(readFile(dataPath("vf/lattice.vf")));
    const std::string good = bytes;
    bytes[10] = '\x07';  // first deflate block: of no known type
    EXPECT_EQ(messageOf([&] { readBytes(".gz", bytes); }), kHeaderError);
    EXPECT_EQ(messageOf([&] { readBytes(".gz", good.substr(0, good.size() / 2)); }), kDataError);
}

}  // namespace
