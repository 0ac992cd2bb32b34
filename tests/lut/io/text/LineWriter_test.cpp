#include "lut/io/text/LineWriter.h"

#include <gtest/gtest.h>

#include <limits>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

TEST(LineWriter, PutsALineTogether) {
    const TempFolder folder;
    const std::string path = folder.path("out");
    const std::string longText(5000, 'x');
    bool wroteAll = false;
    {
        ol::LineWriter file(path, false, wroteAll);
        const float rgb[] = {0.0625F, -1.0F, 1e9F};
        const int sizes[] = {2, std::numeric_limits<int>::min(), std::numeric_limits<int>::max()};
        file.text("size ").integer(33).text({}).endLine();
        file.fixed(0.5F).text("|").fixedTriple(rgb).endLine();
        file.integerTriple(sizes).endLine();
        file.text(longText).endLine();
        file.endLine();
        file.text("unfinished");
    }
    EXPECT_TRUE(wroteAll);
    EXPECT_EQ(readFile(path),
              "size 33\n0.500000|0.062500 -1.000000 1000000000.000000\n"
              "2 -2147483648 2147483647\n" +
                  longText + "\n\nunfinished");
}

TEST(LineWriter, HandsOverLinesOrBlocks) {
    const TempFolder folder;
    bool wroteAll = true;
    ol::LineWriter lines(folder.path("lines"), true, wroteAll);
    EXPECT_FALSE(wroteAll) << "not yet";
    lines.text("one").endLine();
    lines.text("two");
    EXPECT_EQ(readFile(folder.path("lines")), "one\n");

    ol::LineWriter blocks(folder.path("blocks"), false, wroteAll);
    blocks.text("one").endLine();
    EXPECT_EQ(readFile(folder.path("blocks")), "");
    const std::string line(1000, 'x');
    for (int i = 0; i < 300; ++i)
        blocks.text(line).endLine();
    EXPECT_GT(readFile(folder.path("blocks")).size(), 250000U);
}

}  // namespace
