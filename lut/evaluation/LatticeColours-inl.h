// How colours go through a lattice in vectors, for code that is compiled once per instruction set.
// Two shapes of vectors occur: one channel of kLanes colours, where positions, weights and places
// are found; and kSamples whole samples (r, g, b and what follows) side by side, where they are
// blended.
//
// Included by such files alone, which makes the guard special.

#if defined(ORLITH_LUT_EVALUATION_LATTICE_COLOURS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef ORLITH_LUT_EVALUATION_LATTICE_COLOURS_INL_H
#undef ORLITH_LUT_EVALUATION_LATTICE_COLOURS_INL_H
#else
#define ORLITH_LUT_EVALUATION_LATTICE_COLOURS_INL_H
#endif

#include <cmath>
#include <cstdint>

#include "lut/evaluation/Colours-inl.h"
#include "lut/evaluation/PaddedLattice.h"
#include "lut/evaluation/Placement.h"

#if ORLITH_HAS_VECTORS

HWY_BEFORE_NAMESPACE();
namespace Orlith::LUT::HWY_NAMESPACE {
namespace {

constexpr std::size_t kSamples = kLanes / 4;

/// What all colours have in common, in every lane. Places are whole multiples of 1 << kUnit floats.
template <int kUnit>
class Placed {
public:
    HWY_INLINE Placed(const PaddedLattice& lattice, const Placement& placement) {
        const Floats d;
        for (unsigned c = 0; c < 3; ++c) {
            const float scale = placement.scale[c];
            const float inverse = 1.0F / scale;
            int exponent;
            const bool isPowerOfTwo = std::fabs(std::frexp(scale, &exponent)) == 0.5F;
            // -0 - -0 is no -0.
            const bool isZero = placement.offset[c] == 0.0F && !std::signbit(placement.offset[c]);
            onlyMultiplies_ = onlyMultiplies_ && isZero && isPowerOfTwo && std::isfinite(inverse);
            offset_[c] = hn::Set(d, placement.offset[c]);
            scale_[c] = hn::Set(d, scale);
            inverse_[c] = hn::Set(d, inverse);
            last_[c] = hn::Set(d, placement.last[c]);
            unitStride_[c] = hn::Set(d, static_cast<float>(lattice.stride(c) >> kUnit));
            stride_[c] = hn::Set(Ints(), lattice.stride(c));
        }
    }

    HWY_INLINE V position(unsigned c, V point) const {
        // Multiplying by the inverse of a power of two is dividing by it, but faster.
        const V x = onlyMultiplies_ ? hn::Mul(point, inverse_[c])
                                    : hn::Div(hn::Sub(point, offset_[c]), scale_[c]);
        return hn::Min(last_[c], NotBelowZero(x));  // in this order -0 stays where last is 0
    }

    /// Where in the lattice whole-numbered positions stand, in floats. Added to 2^23, whose last
    /// bit counts ones, the number of units is exact (see PaddedLattice::kMostSamples) and stands
    /// in the mantissa as it is.
    HWY_INLINE VI place(const V (&index)[3]) const {
        const V sum = hn::MulAdd(
            index[0], unitStride_[0],
            hn::MulAdd(index[1], unitStride_[1],
                       hn::MulAdd(index[2], unitStride_[2], hn::Set(Floats(), 8388608.0F))));
        return hn::ShiftLeft<kUnit>(hn::And(hn::BitCast(Ints(), sum), hn::Set(Ints(), 0x7FFFFF)));
    }

    /// In floats.
    HWY_INLINE VI stride(unsigned c) const { return stride_[c]; }

private:
    bool onlyMultiplies_ = true;  // on all axes
    V offset_[3];
    V scale_[3];
    V inverse_[3];
    V last_[3];
    V unitStride_[3];
    VI stride_[3];
};

/// kSamples samples, whose places lie side by side.
HWY_INLINE V LoadSamples(const float* samples, const std::int32_t* places) {
    const Floats d;
    const auto at = [&](int i) HWY_ATTR { return hn::LoadDup128(d, samples + places[i]); };
    if constexpr (kSamples == 1) {
        return at(0);
    } else if constexpr (kSamples == 2) {
        const hn::Half<Floats> half;
        return hn::Combine(d, hn::LoadU(half, samples + places[1]),
                           hn::LoadU(half, samples + places[0]));
    } else {
        const auto lower = hn::IfThenElse(hn::FirstN(d, 4), at(0), at(1));
        const auto upper = hn::IfThenElse(hn::FirstN(d, 12), at(2), at(3));
        return hn::ConcatUpperLower(d, upper, lower);
    }
}

/// One number for each of kSamples samples, from the given one on, on all their channels.
HWY_INLINE V SpreadToSamples(V numbers, std::size_t first) {
    alignas(64) static constexpr std::int32_t kLane[64] = {
        0,  0,  0,  0,  1,  1,  1,  1,  2,  2,  2,  2,  3,  3,  3,  3,  4,  4,  4,  4,  5,  5,
        5,  5,  6,  6,  6,  6,  7,  7,  7,  7,  8,  8,  8,  8,  9,  9,  9,  9,  10, 10, 10, 10,
        11, 11, 11, 11, 12, 12, 12, 12, 13, 13, 13, 13, 14, 14, 14, 14, 15, 15, 15, 15};
    return hn::TableLookupLanes(numbers, hn::SetTableIndices(Floats(), kLane + 4 * first));
}

/// Samples as packed colours, and lanes without meaning behind them.
HWY_INLINE V Packed(V samples) {
    alignas(64) static constexpr std::int32_t kLane[16] = {0,  1,  2,  4,  5, 6, 8, 9,
                                                           10, 12, 13, 14, 3, 3, 3, 3};
    alignas(32) static constexpr std::int32_t kLaneOfTwo[8] = {0, 1, 2, 4, 5, 6, 3, 3};
    const Floats d;
    if constexpr (kSamples == 1) {
        return samples;
    } else if constexpr (kSamples == 2) {
        return hn::TableLookupLanes(samples, hn::SetTableIndices(d, kLaneOfTwo));
    } else {
        return hn::TableLookupLanes(samples, hn::SetTableIndices(d, kLane));
    }
}

/// Stores kSamples packed colours, the lanes behind them too, as far as there is room for `left`
/// colours.
HWY_INLINE void StorePacked(V packed, float* out, std::size_t left) {
    if (3 * left >= kLanes) {
        hn::StoreU(packed, Floats(), out);
    } else {
        float apart[kLanes];
        hn::StoreU(packed, Floats(), apart);
        std::copy_n(apart, 3 * std::min(kSamples, left), out);
    }
}

/// Runs a method vector by vector. The places of the next colours are found before those of these
/// are blended: the processor does the one while it waits for the other.
///
/// @param locate  takes the channels of kLanes colours and a slot, 0 or kLanes, for what goes by
///                way of memory; returns the rest
/// @param blend   gives the results of kSamples colours: takes what `locate` returned, the slot and
///                the first of these colours
template <class Locate, class Blend>
HWY_INLINE void forEachLocated(const float* points, float* results, std::size_t count,
                               Locate locate, Blend blend) {
    const auto locateFrom = [&](std::size_t i) HWY_ATTR {
        V channels[3];
        LoadColours(points + 3 * i, count - i, channels);
        return locate(channels, i % (2 * kLanes));
    };
    auto next = locateFrom(0);
    std::size_t done = 0;
    for (; done + 2 * kLanes <= count; done += kLanes) {
        const auto located = next;
        next = locateFrom(done + kLanes);
        // The lanes behind the last colours reach points that are loaded already.
#pragma GCC unroll 4
        for (std::size_t i = 0; i < kLanes; i += kSamples) {
            hn::StoreU(Packed(blend(located, done % (2 * kLanes), i)), Floats(),
                       results + 3 * (done + i));
        }
    }
    for (; done < count; done += kLanes) {
        const auto located = next;
        if (done + kLanes < count) next = locateFrom(done + kLanes);
        for (std::size_t i = 0; i < std::min(kLanes, count - done); i += kSamples) {
            StorePacked(Packed(blend(located, done % (2 * kLanes), i)), results + 3 * (done + i),
                        count - done - i);
        }
    }
}

}  // namespace
}  // namespace Orlith::LUT::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif  // ORLITH_HAS_VECTORS
#endif  // include guard
