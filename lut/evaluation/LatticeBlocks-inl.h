// How all methods take colours through a lattice in vectors, block by block, for code that is
// compiled once per instruction set. Two shapes of vectors occur: one channel of kLanes colours,
// where positions, weights and places are found; and kSamples whole samples (r, g, b, 0) side by
// side, where they are blended. Between the two stand small arrays.
//
// Included by such files alone, which makes the guard special.

#if defined(ORLITH_LUT_EVALUATION_LATTICE_BLOCKS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef ORLITH_LUT_EVALUATION_LATTICE_BLOCKS_INL_H
#undef ORLITH_LUT_EVALUATION_LATTICE_BLOCKS_INL_H
#else
#define ORLITH_LUT_EVALUATION_LATTICE_BLOCKS_INL_H
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

/// Colours that are on their way at the same time: their arrays stay in the nearest cache.
constexpr std::size_t kBlock = 64;

/// Room for whole vectors from every place on.
template <class Number>
using BlockOf = Number[kBlock + kLanes];

/// What all colours have in common, in every lane.
class Placed {
public:
    HWY_INLINE Placed(const PaddedLattice& lattice, const Placement& placement) {
        const Floats d;
        for (unsigned c = 0; c < 3; ++c) {
            const float scale = placement.scale[c];
            const float inverse = 1.0F / scale;
            int exponent;
            const bool isPowerOfTwo = std::fabs(std::frexp(scale, &exponent)) == 0.5F;
            canMultiply_ = canMultiply_ && isPowerOfTwo && std::isfinite(inverse);
            offset_[c] = hn::Set(d, placement.offset[c]);
            scale_[c] = hn::Set(d, scale);
            inverse_[c] = hn::Set(d, inverse);
            last_[c] = hn::Set(d, placement.last[c]);
            floatStride_[c] = hn::Set(d, static_cast<float>(lattice.stride(c)));
            stride_[c] = hn::Set(Ints(), lattice.stride(c));
        }
    }

    HWY_INLINE V position(unsigned c, V point) const {
        const V distance = hn::Sub(point, offset_[c]);
        // Multiplying by the inverse of a power of two is dividing by it, but faster.
        const V x = canMultiply_ ? hn::Mul(distance, inverse_[c]) : hn::Div(distance, scale_[c]);
        return hn::Min(NotBelowZero(x), last_[c]);
    }

    /// Where the samples of whole-numbered positions stand; exact, see kMostFloats.
    HWY_INLINE VI place(const V (&index)[3]) const {
        const V alongRG =
            hn::Add(hn::Mul(index[0], floatStride_[0]), hn::Mul(index[1], floatStride_[1]));
        return hn::ConvertTo(Ints(), hn::Add(alongRG, hn::Mul(index[2], floatStride_[2])));
    }

    HWY_INLINE VI stride(unsigned c) const { return stride_[c]; }

private:
    bool canMultiply_ = true;  // on all axes
    V offset_[3];
    V scale_[3];
    V inverse_[3];
    V last_[3];
    V floatStride_[3];
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

/// One number for each of kSamples samples, on all their channels.
HWY_INLINE V SpreadToSamples(const float* numbers) {
    alignas(64) static constexpr std::int32_t kLane[16] = {0, 0, 0, 0, 1, 1, 1, 1,
                                                           2, 2, 2, 2, 3, 3, 3, 3};
    const Floats d;
    return hn::TableLookupLanes(hn::LoadDup128(d, numbers), hn::SetTableIndices(d, kLane));
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

/// Runs a method block by block.
///
/// @param locate   takes the first of kLanes colours and their channels, fills the block's arrays
/// @param prepare  does what is left for so many colours of the block, counted in whole vectors of
///                 samples
/// @param blend    gives the results of kSamples colours from the given one on
template <class Locate, class Prepare, class Blend>
HWY_INLINE void forEachBlock(const float* points, float* results, std::size_t count, Locate locate,
                             Prepare prepare, Blend blend) {
    for (std::size_t done = 0; done < count; done += kBlock) {
        const std::size_t size = std::min(kBlock, count - done);
        for (std::size_t i = 0; i < size; i += kLanes) {
            V channels[3];
            LoadColours(points + 3 * (done + i), size - i, channels);
            locate(i, channels);
        }
        prepare((size + kSamples - 1) / kSamples * kSamples);
        float* const out = results + 3 * done;
        for (std::size_t i = 0; i < size; i += kSamples) {
            const V packed = Packed(blend(i));
            if (3 * i + kLanes <= 3 * size) {
                hn::StoreU(packed, Floats(), out + 3 * i);
                continue;
            }
            // The lanes behind the colours must not reach beyond the block: the points of the next
            // one may stand there, or nothing.
            float apart[kLanes];
            hn::StoreU(packed, Floats(), apart);
            std::copy_n(apart, 3 * std::min(kSamples, size - i), out + 3 * i);
        }
    }
}

}  // namespace
}  // namespace Orlith::LUT::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif  // ORLITH_HAS_VECTORS
#endif  // include guard
