#include "lut/evaluation/Deviation.h"

namespace Orlith::LUT {

double largestDeviation(const TableLook& source, const TableLook& written) {
    const Range domain = intersection(inputRangeOf(source.points), inputRangeOf(written.points));
    const auto isInside = [&](const RGB& colour) {
        for (unsigned c = 0; c < 3; ++c) {
            if (!(colour[c] >= domain.min[c] && colour[c] <= domain.max[c])) return false;
        }
        return true;
    };
    LookComparison comparison(source.look, written.look);
    const auto addInside = [&](const RGB& colour) {
        if (isInside(colour)) comparison.add(colour);
    };
    forEachInput(written.points, true, addInside);
    // A resampled look is furthest off where the source has its bends.
    forEachInput(source.points, false, addInside);
    for (const RGB& entry : source.points.inputShaper.entries)
        addInside(entry);
    forEachRandom(domain, kRandomColours, [&](const RGB& colour) { comparison.add(colour); });
    return largestOf(comparison.finish());
}

double lookDeviation(const boost::shared_ptr<const LUT>& source,
                     const boost::shared_ptr<const LUT>& written) {
    const Evaluator a(source);
    const Evaluator b(written);
    const auto wayOf = [](const Evaluator& evaluator) {
        return [&](float* rgb, std::size_t count) { evaluator.apply(rgb, rgb, count); };
    };
    return largestDeviation({wayOf(a), *source}, {wayOf(b), *written});
}

}  // namespace Orlith::LUT
