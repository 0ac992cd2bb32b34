#pragma once

#include "lut/LUT.h"

namespace Orlith::LUT {

/// A colour lattice: width x height x depth RGB triples, one axis for each channel.
///
/// Storage  red fastest: sample (r, g, b) is element (b * height + g) * width + r.
/// Values   single precision, nominally 0 to 1, never clamped or rounded here.
/// Domain   index i on channel c stands for the input i * scale_c + offset_c (see transform).
/// Threads  const members may run at once; the others may overlap nothing.
class LUT3D : public LUT {
public:
    LUT3D() = default;

    using LUT::get;

    int width() const override { return width_; }
    int height() const override { return height_; }
    int depth() const override { return depth_; }
    /// Calls the other one, so that a derived class which overrides that sees every change.
    void resize(int n) override;
    void resize(int width, int height, int depth) override;
    RGB& get(int r, int g, int b) override;
    const RGB& get(int r, int g, int b) const override;
    bool is1D() const override { return false; }
    RGB interpolate(const RGB& point, InterpolationMode mode, bool extrapolate) const override;
    void minmax(RGB& min, RGB& max) const override;

private:
    std::size_t element(int r, int g, int b) const {
        const int place = (b * height_ + g) * width_ + r;
        return static_cast<std::size_t>(place);
    }

    int width_ = 0;
    int height_ = 0;
    int depth_ = 0;
};

}  // namespace Orlith::LUT
