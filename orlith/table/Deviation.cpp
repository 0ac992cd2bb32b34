#include "orlith/table/Deviation.h"

namespace orlith {

namespace ol = Orlith::LUT;

double largestDeviation(const TableLook& source, const TableLook& written) {
    const ol::Range domain =
        intersection(inputRangeOf(source.points), inputRangeOf(written.points));
    const auto isInside = [&](const ol::RGB& colour) {
        for (unsigned c = 0; c < 3; ++c) {
            if (!(colour[c] >= domain.min[c] && colour[c] <= domain.max[c])) return false;
        }
        return true;
    };
    ol::LookComparison comparison(source.look, written.look);
    const auto addInside = [&](const ol::RGB& colour) {
        if (isInside(colour)) comparison.add(colour);
    };
    forEachInput(written.points, true, addInside);
    // A resampled look is furthest off where the source has its bends.
    forEachInput(source.points, false, addInside);
    for (const ol::RGB& entry : source.points.inputShaper.entries)
        addInside(entry);
    forEachRandom(domain, ol::kRandomColours,
                  [&](const ol::RGB& colour) { comparison.add(colour); });
    return largestOf(comparison.finish());
}

}  // namespace orlith
