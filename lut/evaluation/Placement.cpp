#include "lut/evaluation/Placement.h"

namespace Orlith::LUT {

Placement::Placement(const LUT& lut) {
    RGB min;
    RGB max;
    lut.minmax(min, max);
    const LatticePosition end = latticePosition(lut, max);
    const int sizes[] = {lut.width(), lut.height(), lut.depth()};
    for (unsigned c = 0; c < 3; ++c) {
        offset[c] = lut.transform[3][c];
        scale[c] = lut.transform[c][c];
        const auto lastIndex = static_cast<float>(sizes[c] - 1);
        const bool isRounding = end[c] > lastIndex && end[c] < lastIndex + 1.0F;
        last[c] = isRounding ? end[c] : lastIndex;
        holdsDomain = holdsDomain && end[c] < lastIndex + 1.0F;
    }
}

CurvePlacement::CurvePlacement(const LUT& lut, bool replaceNaN) : replaceNaN_(replaceNaN) {
    const auto cells = static_cast<float>(lut.width() - 1);
    for (unsigned c = 0; c < 3; ++c) {
        const float scale = lut.transform[c][c];
        offset_[c] = lut.transform[3][c];
        isUnit_[c] = scale == 1.0F / cells && offset_[c] == 0.0F;
        length_[c] = scale * cells;
    }
}

float CurvePlacement::operator()(unsigned channel, float input) const {
    const float place = isUnit_[channel] ? input : (input - offset_[channel]) / length_[channel];
    return replaceNaN_ && place != place ? 0.0F : place;
}

}  // namespace Orlith::LUT
