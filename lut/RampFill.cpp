#include "lut/RampFill.h"

namespace Orlith::LUT {
namespace {

template <class Curve>
void fillRamp(std::vector<RGB>& entries, int n, int max, Curve curve) {
    entries.clear();
    if (n < 1) return;
    entries.resize(static_cast<std::size_t>(n));
    const auto last = static_cast<float>(n - 1);
    const auto scale = static_cast<float>(max);
    for (int i = 0; i < n; ++i) {
        const float t = static_cast<float>(i) / last;
        entries[static_cast<std::size_t>(i)].fill(curve(t) * scale);
    }
}

}  // namespace

void fillLinearRamp(std::vector<RGB>& entries, int n, int max) {
    fillRamp(entries, n, max, [](float t) { return t; });
}

void fillSmoothRamp(std::vector<RGB>& entries, int n, int max) {
    // The sum stands in this form because its rounding is part of the files.
    fillRamp(entries, n, max, [](float t) { return 3.0F * (t * t) - (t * (t * t) + t * (t * t)); });
}

}  // namespace Orlith::LUT
