#include "lut/io/Remarks.h"

#include <gtest/gtest.h>

namespace {

TEST(Remarks, KeepFiveOfAKindAndCountTheOthers) {
    Orlith::LUT::Remarks remarks;
    for (std::uint64_t line = 1; line <= 8; ++line)
        remarks.add("word", line, "unknown");
    remarks.add("range", 9, "not used");
    remarks.addLast(10, "the reason");
    std::string text;
    for (const auto& remark : remarks.list())
        text += std::to_string(remark.line) + " " + remark.text + "; ";
    EXPECT_EQ(text,
              "1 unknown; 2 unknown; 3 unknown; 4 unknown; 5 unknown; 0 and 3 more like this one; "
              "9 not used; 10 the reason; ");
    remarks.clear();
    EXPECT_TRUE(remarks.list().empty());
}

}  // namespace
