// The cubic method in vectors. Included by LatticeVectors.cpp alone, once per instruction set,
// which makes the guard special.

#if defined(ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H
#undef ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H
#else
#define ORLITH_LUT_EVALUATION_CUBIC_VECTORS_INL_H
#endif

#include <hwy/cache_control.h>

#include "lut/evaluation/LatticeColours-inl.h"

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

/// What is multiplied by a power of two is so without rounding, unless it overflows: fused or by
/// itself, before or behind a sum, it makes no difference.
HWY_INLINE V CatmullRom(V p0, V p1, V p2, V p3, const Powers& power) {
    const auto times = [](float factor, V v)
                           HWY_ATTR { return hn::Mul(hn::Set(Floats(), factor), v); };
    const auto addTimes = [](V sum, float factor, V v)
                              HWY_ATTR { return hn::MulAdd(hn::Set(Floats(), factor), v, sum); };
    const V cubic = hn::Add(hn::Sub(hn::Sub(times(3.0F, p1), times(3.0F, p2)), p0), p3);
    const V evenHalf = addTimes(p0, 2.0F, p2);
    const V square = hn::Sub(hn::MulSub(hn::Set(Floats(), 2.0F), evenHalf, times(5.0F, p1)), p3);
    const V linear = hn::Sub(p2, p0);
    const V curved = hn::Add(hn::Mul(cubic, power.t3), hn::Mul(square, power.t2));
    const V sum = hn::Add(curved, hn::Mul(linear, power.t));
#if HWY_NATIVE_FMA
    return addTimes(p1, 0.5F, sum);
#else
    // Halving a number next to 0 rounds: last.
    return times(0.5F, addTimes(sum, 2.0F, p1));
#endif
}

/// Colours on their way through the curves together, few enough for the nearest cache: along red
/// and along blue a line of samples at once, then along green the four that matter.
class CubicBlock {
public:
    static constexpr std::size_t kColours = 64;

    HWY_INLINE CubicBlock(const PaddedLattice& lattice, const Placement& placement)
        : placed_(lattice, placement),
          alongR_(lattice.stride(0)),
          alongB_(lattice.stride(2)),
          first_(lattice.first() - alongR_ - alongB_) {}

    /// For kLanes colours from the given one of the block on.
    HWY_INLINE void locate(std::size_t i, const V (&point)[3]) {
        const Floats d;
        V lower[3];
        for (unsigned c = 0; c < 3; ++c) {
            const V x = placed_.position(c, point[c]);
            lower[c] = hn::Floor(x);
            // By way of integers, which have no negative 0.
            const V t = hn::Sub(x, hn::ConvertTo(d, hn::ConvertTo(Ints(), lower[c])));
            const V t2 = hn::Mul(t, t);
            hn::Store(t, d, powers_[c][0] + i);
            hn::Store(t2, d, powers_[c][1] + i);
            hn::Store(hn::Mul(t2, t), d, powers_[c][2] + i);
        }
        const V line = hn::Floor(hn::Mul(lower[1], hn::Set(d, 0.5F)));
        const VI second = hn::ConvertTo(Ints(), hn::Sub(lower[1], hn::Add(line, line)));
        lower[1] = line;
        hn::Store(placed_.place(lower), Ints(), places_ + i);
        const VI ownLine = hn::ShiftLeft<4>(hn::Iota(Ints(), static_cast<std::int32_t>(i)));
        hn::Store(hn::Add(ownLine, hn::Add(second, hn::Add(second, second))), Ints(), inB_ + i);
    }

    /// For the first colours of the block.
    HWY_INLINE void followRed(std::size_t count) {
        const Floats d;
        for (std::size_t i = 0; i < count; ++i) {
            const Powers power = powers(i, 0);
            const float* const lines = first_ + places_[i];
            const float* const linesAhead = first_ + places_[std::min(i + 2, count - 1)];
            for (std::ptrdiff_t b = 0; b < 4; ++b) {
                for (std::ptrdiff_t r = 0; r < 4; ++r)
                    hwy::Prefetch(linesAhead + b * alongB_ + r * alongR_);
                for (std::ptrdiff_t lane = 0; lane < kLine; lane += kLanes) {
                    const float* const p = lines + b * alongB_ + lane;
                    const V curve = CatmullRom(hn::Load(d, p), hn::Load(d, p + alongR_),
                                               hn::Load(d, p + 2 * alongR_),
                                               hn::Load(d, p + 3 * alongR_), power);
                    hn::Store(curve, d, behindR_[i][b] + lane);
                }
            }
        }
    }

    HWY_INLINE void followBlue(std::size_t count) {
        const Floats d;
        for (std::size_t i = 0; i < count; ++i) {
            const Powers power = powers(i, 2);
            for (std::ptrdiff_t lane = 0; lane < kLine; lane += kLanes) {
                const auto at = [&](int b) HWY_ATTR { return hn::Load(d, behindR_[i][b] + lane); };
                hn::Store(CatmullRom(at(0), at(1), at(2), at(3), power), d, behindB_[i] + lane);
            }
        }
    }

    /// The results of kSamples colours.
    HWY_INLINE V followGreen(std::size_t i) const {
        const auto power = [&](int k) HWY_ATTR {
            const std::size_t lane = i % kLanes;
            return SpreadToSamples(hn::Load(Floats(), powers_[1][k] + (i - lane)), lane);
        };
        const auto at = [&](int g) HWY_ATTR { return LoadSamples(behindB_[0] + 3 * g, inB_ + i); };
        return CatmullRom(at(0), at(1), at(2), at(3), Powers{power(0), power(1), power(2)});
    }

private:
    static constexpr std::ptrdiff_t kLine = PaddedLattice::kFloatsInLine;

    HWY_INLINE Powers powers(std::size_t i, unsigned c) const {
        const Floats d;
        return Powers{hn::Set(d, powers_[c][0][i]), hn::Set(d, powers_[c][1][i]),
                      hn::Set(d, powers_[c][2][i])};
    }

    const Placed<4> placed_;  // a line of sixteen floats
    const std::ptrdiff_t alongR_;
    const std::ptrdiff_t alongB_;
    const float* const first_;  // the first line that the first sample takes
    alignas(64) std::int32_t places_[kColours];
    alignas(64) float powers_[3][3][kColours];
    alignas(64) float behindR_[kColours][4][kLine];  // by blue
    alignas(64) float behindB_[kColours][kLine];
    alignas(64) std::int32_t inB_[kColours];  // where in behindB_ the first of four samples stands
};

void cubic(const PaddedLattice& lattice, const Placement& placement, const float* points,
           float* results, std::size_t count) {
    CubicBlock block(lattice, placement);
    for (std::size_t done = 0; done < count; done += CubicBlock::kColours) {
        const std::size_t size = std::min(CubicBlock::kColours, count - done);
        for (std::size_t i = 0; i < size; i += kLanes) {
            V channels[3];
            LoadColours(points + 3 * (done + i), size - i, channels);
            block.locate(i, channels);
        }
        const std::size_t whole = (size + kSamples - 1) / kSamples * kSamples;
        block.followRed(whole);
        block.followBlue(whole);
        // The lanes behind the block's colours must not reach the points of the next ones.
        for (std::size_t i = 0; i < size; i += kSamples)
            StorePacked(Packed(block.followGreen(i)), results + 3 * (done + i), size - i);
    }
}

}  // namespace
}  // namespace Orlith::LUT::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif  // ORLITH_HAS_VECTORS
#endif  // include guard
