#pragma once

#include "lut/LUT.h"

namespace Orlith::LUT {

/// Three curves, one for each channel, of N samples that cover the inputs 0 to 1.
///
/// Storage  sample i holds red, green and blue of place i.
/// Values   single precision, nominally 0 to 1, never clamped or rounded here.
class LUT1D : public LUT {
public:
    LUT1D() = default;

    using LUT::get;
    using LUT::resize;

    int width() const override { return sampleCount_; }
    void resize(int n) override;
    RGB& get(int i) override;
    const RGB& get(int i) const override;
    bool is1D() const override { return true; }
    RGB interpolate(const RGB& point, InterpolationMode mode, bool extrapolate) const override;
    void minmax(RGB& min, RGB& max) const override;

private:
    int sampleCount_ = 0;
};

}  // namespace Orlith::LUT
