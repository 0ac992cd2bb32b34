#include "lut/Interpolation.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>

#include "lut/Exception.h"
#include "lut/FloatToInt.h"

namespace Orlith::LUT {
namespace {

/// The lattice as evaluation sees it: sizes, and samples that are read within their bounds only.
class Lattice {
public:
    Lattice(const LUT& lut, const char* wrongKind) {
        if (lut.is1D()) throw Exception(wrongKind);
        sizes_ = {lut.width(), lut.height(), lut.depth()};
        samples_ = lut.data();
        // Only with samples: two huge sides and a third of 0 would overflow.
        if (!empty()) last_ = sizes_[0] * sizes_[1] * sizes_[2] - 1;
    }

    bool empty() const { return samples_ == nullptr; }

    int clamp(unsigned axis, int index) const {
        return std::max(0, std::min(index, sizes_[axis] - 1));
    }

    bool inside(unsigned axis, int index) const { return 0 <= index && index < sizes_[axis]; }

    /// The three floats of sample (r, g, b). Indices may lie outside the lattice: the element that
    /// they come to, in wrapping 32-bit arithmetic, is limited to those stored.
    const float* sample(int r, int g, int b) const {
        const auto element = static_cast<std::int32_t>(
            (unsigned(b) * unsigned(sizes_[1]) + unsigned(g)) * unsigned(sizes_[0]) + unsigned(r));
        return samples_ + 3 * static_cast<std::ptrdiff_t>(std::clamp(element, 0, last_));
    }

private:
    std::array<int, 3> sizes_{};
    const float* samples_ = nullptr;
    std::int32_t last_ = -1;
};

RGB toRGB(const float* sample) {
    return RGB(sample[0], sample[1], sample[2]);
}

RGB zero() {
    return RGB(0.0F, 0.0F, 0.0F);
}

float latticePosition(const LUT& lut, const RGB& point, unsigned axis) {
    return (point[axis] - lut.transform[3][axis]) / lut.transform[axis][axis];
}

float mix(float a, float b, float weight) {
    return a + weight * (b - a);
}

}  // namespace

RGB StepInterpolate(const LUT& lut, const RGB& point) {
    const Lattice lattice(lut, "StepInterpolate: expecting a 3D lut");
    if (lattice.empty()) return zero();
    int index[3];
    for (unsigned c = 0; c < 3; ++c) {
        index[c] = lattice.clamp(c, toInt32(std::floor(latticePosition(lut, point, c))));
    }
    return toRGB(lattice.sample(index[0], index[1], index[2]));
}

RGB TrilinearInterpolate(const LUT& lut, const RGB& point) {
    const Lattice lattice(lut, "TrilinearInterpolate: expecting a 3D lut");
    if (lattice.empty()) return zero();
    int index[3][2];
    float weight[3][2];
    for (unsigned c = 0; c < 3; ++c) {
        const float x = latticePosition(lut, point, c);
        const float lower = std::floor(x);
        const int i = toInt32(lower);
        // Deliberate: only the upper index is clamped. At the upper face it falls onto the lower
        // one with weight 0, so that the face is exact.
        index[c][0] = i;
        index[c][1] = lattice.clamp(c, i < std::numeric_limits<int>::max() ? i + 1 : i);
        weight[c][0] = (lower - x) + 1.0F;
        weight[c][1] = (x - (lower + 1.0F)) + 1.0F;
    }
    float sum[3] = {0.0F, 0.0F, 0.0F};
    for (int corner = 0; corner < 8; ++corner) {  // red fastest: the order of the sum is fixed
        const int r = corner & 1;
        const int g = (corner >> 1) & 1;
        const int b = corner >> 2;
        const float* sample = lattice.sample(index[0][r], index[1][g], index[2][b]);
        for (int c = 0; c < 3; ++c)
            sum[c] += sample[c] * weight[0][r] * weight[1][g] * weight[2][b];
    }
    return toRGB(sum);
}

namespace {

/// Catmull-Rom through p1 and p2, t from 0 at p1 to 1 at p2.
float catmullRom(float p0, float p1, float p2, float p3, float t) {
    const float t2 = t * t;
    const float t3 = t2 * t;
    return 0.5F * ((3.0F * p1 - 3.0F * p2 - p0 + p3) * t3 +
                   (4.0F * p2 + 2.0F * p0 - 5.0F * p1 - p3) * t2 + (p2 - p0) * t + 2.0F * p1);
}

RGB catmullRom(const RGB (&p)[4], float t) {
    RGB result;
    for (unsigned c = 0; c < 3; ++c)
        result[c] = catmullRom(p[0][c], p[1][c], p[2][c], p[3][c], t);
    return result;
}

RGB extrapolate(const Lattice& lattice, int r, int g, int b) {
    if (lattice.inside(0, r) && lattice.inside(1, g) && lattice.inside(2, b)) {
        return toRGB(lattice.sample(r, g, b));
    }
    const int requested[3] = {r, g, b};
    int clamped[3];
    for (unsigned axis = 0; axis < 3; ++axis)
        clamped[axis] = lattice.clamp(axis, requested[axis]);
    const float* edge = lattice.sample(clamped[0], clamped[1], clamped[2]);

    float distance[3];
    for (unsigned axis = 0; axis < 3; ++axis) {
        distance[axis] =
            static_cast<float>(std::abs(std::int64_t{clamped[axis]} - requested[axis]));
    }
    const float total = distance[0] + distance[1] + distance[2];
    float result[3] = {0.0F, 0.0F, 0.0F};
    for (unsigned axis = 0; axis < 3; ++axis) {
        int inward[3] = {clamped[0], clamped[1], clamped[2]};
        if (requested[axis] != clamped[axis]) {
            inward[axis] += requested[axis] < clamped[axis] ? 1 : -1;
        }
        inward[axis] = lattice.clamp(axis, inward[axis]);
        const float* neighbour = lattice.sample(inward[0], inward[1], inward[2]);
        for (int c = 0; c < 3; ++c) {
            const float slope = edge[c] - neighbour[c];
            result[c] += (distance[axis] / total) * (edge[c] + slope * distance[axis]);
        }
    }
    return toRGB(result);
}

}  // namespace

RGB CubicInterpolate(const LUT& lut, const RGB& point) {
    const Lattice lattice(lut, "CubicInterpolate: expecting a 3D lut");
    if (lattice.empty()) return zero();
    int index[3];
    float t[3];
    for (unsigned c = 0; c < 3; ++c) {
        const double x = static_cast<double>(latticePosition(lut, point, c));
        // Room for the two neighbours on either side of a point that is very far away.
        constexpr int kFar = std::numeric_limits<int>::max() - 2;
        index[c] = std::clamp(toInt32(std::floor(x)), -kFar, kFar);
        t[c] = static_cast<float>(x - index[c]);
    }
    RGB alongG[4];
    for (int g = 0; g < 4; ++g) {
        RGB alongB[4];
        for (int b = 0; b < 4; ++b) {
            RGB alongR[4];
            for (int r = 0; r < 4; ++r) {
                alongR[r] =
                    extrapolate(lattice, index[0] - 1 + r, index[1] - 1 + g, index[2] - 1 + b);
            }
            alongB[b] = catmullRom(alongR, t[0]);
        }
        alongG[g] = catmullRom(alongB, t[2]);
    }
    return catmullRom(alongG, t[1]);
}

RGB Extrapolate(const LUT& lut, int r, int g, int b) {
    const Lattice lattice(lut, "Extrapolate: expecting a 3D lut");
    if (lattice.empty()) return zero();
    return extrapolate(lattice, r, g, b);
}

RGB LinearStaggeredInterpolate(const LUT& lut, const RGB& point) {
    const Lattice lattice(lut, "LinearStaggeredInterpolate: expecting a 3D lut");
    if (lattice.empty()) return zero();
    float x[3];
    float nearest[3];
    float weight[3];
    // index[axis]: the nearest point, its neighbour on the colour's side, the one above the
    // nearest.
    enum { kNearest, kBeside, kAbove };
    int index[3][3];
    for (unsigned c = 0; c < 3; ++c) {
        x[c] = latticePosition(lut, point, c);
        nearest[c] = static_cast<float>(std::round(static_cast<double>(x[c])));
        weight[c] = std::fabs(x[c] - nearest[c]);
        const float beside = x[c] > nearest[c] ? nearest[c] + 1.0F : nearest[c] - 1.0F;
        index[c][kNearest] = lattice.clamp(c, toInt32(nearest[c]));
        index[c][kBeside] = lattice.clamp(c, toInt32(beside));
        index[c][kAbove] = lattice.clamp(c, toInt32(nearest[c] + 1.0F));
    }

    RGB result;
    for (unsigned c = 0; c < 3; ++c) {
        // Bilinear over the other two axes: first along `inner` (blue, or green for the blue
        // output), then along `outer`; at the two points of the channel's own axis.
        const unsigned inner = c == 2 ? 1 : 2;
        const unsigned outer = c == 0 ? 1 : 0;
        const auto plane = [&](int own) {
            const auto line = [&](int outerIndex) {
                int at[3];
                at[c] = own;
                at[outer] = outerIndex;
                at[inner] = index[inner][kNearest];
                const float a = lattice.sample(at[0], at[1], at[2])[c];
                at[inner] = index[inner][kBeside];
                const float b = lattice.sample(at[0], at[1], at[2])[c];
                return mix(a, b, weight[inner]);
            };
            return mix(line(index[outer][kNearest]), line(index[outer][kBeside]), weight[outer]);
        };
        result[c] =
            mix(plane(index[c][kNearest]), plane(index[c][kAbove]), x[c] - (nearest[c] - 0.5F));
    }
    return result;
}

}  // namespace Orlith::LUT
