#include "report/Comparison.h"

#include "lut/evaluation/Range.h"

namespace report {

namespace ol = Orlith::LUT;

ol::Differences compareLooks(const ol::LUT& a, const Look& lookA, const ol::LUT& b,
                             const Look& lookB) {
    ol::LookComparison comparison(lookA, lookB);
    const auto add = [&](const ol::RGB& colour) { comparison.add(colour); };
    forEachInput(pointCount(a) >= pointCount(b) ? a : b, false, add);
    forEachRandom(inputRangeOf(a), ol::kRandomColours / 2, add);
    forEachRandom(inputRangeOf(b), ol::kRandomColours / 2, add);
    return comparison.finish();
}

}  // namespace report
