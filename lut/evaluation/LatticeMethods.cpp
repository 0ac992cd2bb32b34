#include "lut/evaluation/LatticeMethods.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <limits>

#include "lut/FloatToInt.h"

namespace Orlith::LUT {

namespace {

RGB toRGB(const float* sample) {
    return RGB(sample[0], sample[1], sample[2]);
}

float mix(float a, float b, float weight) {
    return a + weight * (b - a);
}

/// The index above, which is the same one at the end of the numbers.
int above(int index) {
    return index < std::numeric_limits<int>::max() ? index + 1 : index;
}

}  // namespace

RGB stepAt(const Lattice& lattice, const LatticePosition& x) {
    int index[3];
    for (unsigned c = 0; c < 3; ++c)
        index[c] = lattice.clamp(c, toInt32(std::floor(x[c])));
    return toRGB(lattice.sample(index[0], index[1], index[2]));
}

RGB staggeredAt(const Lattice& lattice, const LatticePosition& x) {
    float nearest[3];
    float weight[3];
    // index[axis]: the nearest point, its neighbour on the colour's side, the one above the
    // nearest.
    enum { kNearest, kBeside, kAbove };
    int index[3][3];
    for (unsigned c = 0; c < 3; ++c) {
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

RGB trilinearAt(const Lattice& lattice, const LatticePosition& x) {
    int index[3][2];
    float weight[3][2];
    for (unsigned c = 0; c < 3; ++c) {
        const float lower = std::floor(x[c]);
        const int i = toInt32(lower);
        // Deliberate: only the upper index is clamped. At the upper face it falls onto the lower
        // one with weight 0, so that the face is exact.
        index[c][0] = i;
        index[c][1] = lattice.clamp(c, above(i));
        weight[c][0] = (lower - x[c]) + 1.0F;
        weight[c][1] = (x[c] - (lower + 1.0F)) + 1.0F;
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

RGB tetrahedralAt(const Lattice& lattice, const LatticePosition& x) {
    int corner[3];
    int upper[3];
    float fraction[3];
    for (unsigned c = 0; c < 3; ++c) {
        const float lower = std::floor(x[c]);
        const int i = toInt32(lower);
        corner[c] = lattice.clamp(c, i);
        upper[c] = lattice.clamp(c, above(i));
        fraction[c] = x[c] - lower;
    }
    unsigned axis[3] = {0, 1, 2};
    const auto putLargerFirst = [&](unsigned& a, unsigned& b) {
        if (fraction[a] < fraction[b]) std::swap(a, b);
    };
    putLargerFirst(axis[0], axis[1]);
    putLargerFirst(axis[1], axis[2]);
    putLargerFirst(axis[0], axis[1]);

    const float f[3] = {fraction[axis[0]], fraction[axis[1]], fraction[axis[2]]};
    const float weight[4] = {1.0F - f[0], f[0] - f[1], f[1] - f[2], f[2]};
    const float* sample[4];
    for (unsigned step = 0;; ++step) {
        sample[step] = lattice.sample(corner[0], corner[1], corner[2]);
        if (step == 3) break;
        corner[axis[step]] = upper[axis[step]];
    }
    RGB result;
    for (unsigned c = 0; c < 3; ++c) {
        result[c] = weight[0] * sample[0][c] + weight[1] * sample[1][c] + weight[2] * sample[2][c] +
                    weight[3] * sample[3][c];
    }
    return result;
}

RGB extrapolatedSample(const Lattice& lattice, int r, int g, int b) {
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

namespace {

/// Catmull-Rom through the second and third of four points, t from 0 to 1 between these; several
/// curves side by side, whose points lie kCurves floats apart.
template <int kCurves>
void catmullRom(const float* points, float t, float* result) {
    const float t2 = t * t;
    const float t3 = t2 * t;
    for (int i = 0; i < kCurves; ++i) {
        const float p0 = points[i];
        const float p1 = points[kCurves + i];
        const float p2 = points[2 * kCurves + i];
        const float p3 = points[3 * kCurves + i];
        result[i] =
            0.5F * ((3.0F * p1 - 3.0F * p2 - p0 + p3) * t3 +
                    (4.0F * p2 + 2.0F * p0 - 5.0F * p1 - p3) * t2 + (p2 - p0) * t + 2.0F * p1);
    }
}

/// The 4 x 4 x 4 samples from `first` on, red slowest, then blue, then green: the points of a curve
/// along red lie 48 floats apart, the results along blue 12, those along green 3.
using Neighbourhood = std::array<float, 192>;

Neighbourhood fetch(const Lattice& lattice, const std::array<int, 3>& first) {
    bool inside = true;
    for (unsigned c = 0; c < 3; ++c)
        inside = inside && first[c] >= 0 && first[c] <= lattice.last(c) - 3;
    Neighbourhood samples;
    float* curve = samples.data();
    for (int b = 0; b < 4; ++b) {
        for (int g = 0; g < 4; ++g, curve += 3) {
            const float* row = lattice.sample(first[0], first[1] + g, first[2] + b);
            float* place = curve;
            for (int r = 0; r < 4; ++r, row += 3, place += 48) {
                if (inside) {
                    std::copy_n(row, 3, place);
                } else {
                    extrapolatedSample(lattice, first[0] + r, first[1] + g, first[2] + b)
                        .copy_out(place);
                }
            }
        }
    }
    return samples;
}

}  // namespace

RGB cubicAt(const Lattice& lattice, const LatticePosition& position) {
    std::array<int, 3> first;
    float t[3];
    for (unsigned c = 0; c < 3; ++c) {
        const double x = static_cast<double>(position[c]);
        // Room for the two neighbours on either side of a point that is very far away.
        constexpr int kFar = std::numeric_limits<int>::max() - 2;
        const int index = std::clamp(toInt32(std::floor(x)), -kFar, kFar);
        first[c] = index - 1;
        t[c] = static_cast<float>(x - index);
    }
    const Neighbourhood samples = fetch(lattice, first);
    float alongR[48];
    float alongB[12];
    float alongG[3];
    catmullRom<48>(samples.data(), t[0], alongR);
    catmullRom<12>(alongR, t[2], alongB);
    catmullRom<3>(alongB, t[1], alongG);
    return toRGB(alongG);
}

}  // namespace Orlith::LUT
