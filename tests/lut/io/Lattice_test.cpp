#include "lut/io/Lattice.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

#include "tests/support/Tables.h"

namespace {

using namespace test;

constexpr int kMost = std::numeric_limits<int>::max();

TEST(Lattice, IsWalkedRedOrBlueFastest) {
    const auto lut = markedLattice(2, 3, 4);
    const ol::LatticeSize size = ol::LatticeSize::of(*lut);
    const auto sample = [&](std::size_t element) { return lut->data() + 3 * element; };

    std::vector<float> seen;
    ol::forEachRedFastest(size, [&](std::size_t element) { seen.push_back(*sample(element)); });
    std::vector<float> expected;
    for (int b = 0; b < 4; ++b)
        for (int g = 0; g < 3; ++g)
            for (int r = 0; r < 2; ++r)
                expected.push_back(markedSample(r, g, b)[0]);
    EXPECT_EQ(seen, expected);

    seen.clear();
    ol::forEachBlueFastest(size, [&](std::size_t element) { seen.push_back(*sample(element)); });
    expected.clear();
    for (int r = 0; r < 2; ++r)
        for (int g = 0; g < 3; ++g)
            for (int b = 0; b < 4; ++b)
                expected.push_back(markedSample(r, g, b)[0]);
    EXPECT_EQ(seen, expected);
}

TEST(Lattice, HasNoLoopWithoutPoints) {
    for (const ol::LatticeSize& size :
         {ol::LatticeSize{0, kMost, kMost}, {kMost, 0, kMost}, {kMost, kMost, 0}, {-1, 2, 2}}) {
        ol::forEachRedFastest(size, [](std::size_t) { FAIL(); });
        ol::forEachBlueFastest(size, [](std::size_t) { FAIL(); });
        EXPECT_FALSE(ol::LatticePosition().isInside(size));
    }
}

TEST(Lattice, StartsOverBehindItsLastPoint) {
    const ol::LatticeSize size{2, 3, 4};
    ol::LatticePosition position;
    for (std::size_t line = 0; line < 50; ++line) {
        ASSERT_TRUE(position.isInside(size));
        ASSERT_EQ(position.element(size), line % 24);
        position.advanceRedFastest(size);
    }
    // A smaller size in between: outside first, then never further out.
    position = {1, 2, 3};
    const ol::LatticeSize smaller{2, 2, 2};
    EXPECT_FALSE(position.isInside(smaller));
    position.advanceRedFastest(smaller);
    EXPECT_TRUE(position.isInside(smaller));
}

}  // namespace
