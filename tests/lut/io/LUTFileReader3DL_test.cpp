#include "lut/io/LUTFileReader3DL.h"

#include <gtest/gtest.h>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"
#include "tests/support/ThreeDL.h"

namespace {

using namespace test;
namespace op = Orlith::Property;

TEST(ThreeDLReader, RefusesWithoutItsPropertiesInOrder) {
    ol::LUTFileReader3DL reader;
    const auto refusal = [&] { return messageOf([&] { reader.read("/no/such.3dl"); }); };
    EXPECT_EQ(refusal(), "3DL file reader: unable to find 3DL format to read");
    setProperty<op::String>(reader, "format3DL", "auto");
    EXPECT_EQ(refusal(), "3DL file reader: unable to find output bitdepth to read");
    setProperty<op::Int>(reader, "outputBitDepth", -2);
    EXPECT_EQ(refusal(), "3DL file reader: unable to find normalize property");
    setProperty<op::Int>(reader, "normalizeOutput", 0);
    EXPECT_EQ(refusal(), "3DL file reader: unable to open file");

    ol::LUTFileReader3DL wordy;
    setProperty<op::String>(wordy, "format3DL", "Lustre");
    EXPECT_EQ(messageOf([&] { wordy.read("/no/such.3dl"); }),
              "3DL file reader: invalid 3DL format specified for reading");
    ol::LUTFileReader3DL wrongKind;
    setProperty<op::Double>(wrongKind, "outputBitDepth", 12.0);
    Reading3DL()(wrongKind);
    EXPECT_EQ(messageOf([&] { wrongKind.read("/no/such.3dl"); }),
              "3DL file reader: unable to find output bitdepth to read");
}

}  // namespace
