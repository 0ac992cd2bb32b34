#include "lut/io/text/LineWriter.h"

#include <gtest/gtest.h>

#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

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
    blocks.text(std::string(300000, 'x')).endLine();
    EXPECT_GT(readFile(folder.path("blocks")).size(), 250000U);
}

}  // namespace
