// The cubic method in vectors. Included by LatticeVectors.cpp alone, once per instruction set,
// which makes the guard special.

#if defined(ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H
#undef ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H
#else
#define ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H
#endif

#include "lut/evaluation/LatticeBlocks-inl.h"

#if ORLITH_HAS_VECTORS

HWY_BEFORE_NAMESPACE();
namespace Orlith::LUT::HWY_NAMESPACE {
namespace {

/// t, its square and its cube.
struct Powers {
    V t;
    V t2;
    V t3;
};

HWY_INLINE V CatmullRom(V p0, V p1, V p2, V p3, const Powers& power) {
    const auto times = [](float factor, V v)
                           HWY_ATTR { return hn::Mul(hn::Set(Floats(), factor), v); };
    // What is doubled is so without rounding: one operation for two, unless it overflows.
    const auto addTwice = [](V sum, V v)
                              HWY_ATTR { return hn::MulAdd(hn::Set(Floats(), 2.0F), v, sum); };
    const V cubic = hn::Add(hn::Sub(hn::Sub(times(3.0F, p1), times(3.0F, p2)), p0), p3);
    const V square = hn::Sub(hn::Sub(addTwice(times(4.0F, p2), p0), times(5.0F, p1)), p3);
    const V linear = hn::Sub(p2, p0);
    const V curved = hn::Add(hn::Mul(cubic, power.t3), hn::Mul(square, power.t2));
    return times(0.5F, addTwice(hn::Add(curved, hn::Mul(linear, power.t)), p1));
}

void cubic(const PaddedLattice& lattice, const Placement& placement, const float* points,
           float* results, std::size_t count) {
    const Placed placed(lattice, placement);
    const std::ptrdiff_t alongR = lattice.stride(0);
    const std::ptrdiff_t alongB = lattice.stride(2);
    const float* const first = lattice.first() - alongR - lattice.stride(1) - alongB;
    alignas(64) BlockOf<std::int32_t> places;
    alignas(64) BlockOf<float> powers[3][3];
    // Four samples along green for each colour: behind the curves along red, by blue; and behind
    // those along blue.
    alignas(64) float behindR[kBlock][4][16];
    alignas(64) float behindB[kBlock][16];
    const auto locate = [&](std::size_t i, const V(&point)[3]) HWY_ATTR {
        const Floats d;
        V lower[3];
        for (unsigned c = 0; c < 3; ++c) {
            const V x = placed.position(c, point[c]);
            lower[c] = hn::Floor(x);
            // By way of integers, which have no negative 0.
            const V t = hn::Sub(x, hn::ConvertTo(d, hn::ConvertTo(Ints(), lower[c])));
            const V t2 = hn::Mul(t, t);
            hn::Store(t, d, powers[c][0] + i);
            hn::Store(t2, d, powers[c][1] + i);
            hn::Store(hn::Mul(t2, t), d, powers[c][2] + i);
        }
        hn::Store(placed.place(lower), Ints(), places + i);
    };
    const auto ofColour = [&](std::size_t i, unsigned c) HWY_ATTR {
        const Floats d;
        return Powers{hn::Set(d, powers[c][0][i]), hn::Set(d, powers[c][1][i]),
                      hn::Set(d, powers[c][2][i])};
    };
    const auto prepare = [&](std::size_t size) HWY_ATTR {
        const Floats d;
        for (std::size_t i = 0; i < size; ++i) {
            const Powers power = ofColour(i, 0);
            for (std::size_t b = 0; b < 4; ++b) {
                for (std::size_t g = 0; g < 4; g += kSamples) {
                    const float* const p = first + places[i] + b * alongB + 4 * g;
                    hn::Store(CatmullRom(hn::LoadU(d, p), hn::LoadU(d, p + alongR),
                                         hn::LoadU(d, p + 2 * alongR), hn::LoadU(d, p + 3 * alongR),
                                         power),
                              d, behindR[i][b] + 4 * g);
                }
            }
        }
        for (std::size_t i = 0; i < size; ++i) {
            const Powers power = ofColour(i, 2);
            for (std::size_t g = 0; g < 4; g += kSamples) {
                const auto p = [&](int b) HWY_ATTR { return hn::Load(d, behindR[i][b] + 4 * g); };
                hn::Store(CatmullRom(p(0), p(1), p(2), p(3), power), d, behindB[i] + 4 * g);
            }
        }
    };
    const auto blend = [&](std::size_t i) HWY_ATTR {
        static constexpr std::int32_t kColours[4] = {0, 16, 32, 48};
        const auto p = [&](int g) HWY_ATTR { return LoadSamples(behindB[i] + 4 * g, kColours); };
        const Powers power{SpreadToSamples(powers[1][0] + i), SpreadToSamples(powers[1][1] + i),
                           SpreadToSamples(powers[1][2] + i)};
        return CatmullRom(p(0), p(1), p(2), p(3), power);
    };
    forEachBlock(points, results, count, locate, prepare, blend);
}

}  // namespace
}  // namespace Orlith::LUT::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif  // ORLITH_HAS_VECTORS
#endif  // include guard
