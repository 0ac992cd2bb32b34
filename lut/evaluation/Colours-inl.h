// Colours in vectors, for code that is compiled once per instruction set. Included by such files
// alone, which makes the guard special.

#if defined(ORLITH_LUT_EVALUATION_COLOURS_INL_H) == defined(HWY_TARGET_TOGGLE)
#ifdef ORLITH_LUT_EVALUATION_COLOURS_INL_H
#undef ORLITH_LUT_EVALUATION_COLOURS_INL_H
#else
#define ORLITH_LUT_EVALUATION_COLOURS_INL_H
#endif

#include <hwy/highway.h>

#include <algorithm>
#include <cstddef>

// Where vectors are slower than plain code: one lane at a time, or emulated.
#undef ORLITH_HAS_VECTORS
#if HWY_TARGET == HWY_SCALAR || HWY_TARGET == HWY_EMU128
#define ORLITH_HAS_VECTORS 0
#else
#define ORLITH_HAS_VECTORS 1

HWY_BEFORE_NAMESPACE();
namespace Orlith::LUT::HWY_NAMESPACE {
namespace hn = hwy::HWY_NAMESPACE;

using Floats = hn::CappedTag<float, 16>;
using Ints = hn::RebindToSigned<Floats>;
using V = hn::Vec<Floats>;
using VI = hn::Vec<Ints>;

/// Colours whose channels fill a vector each.
constexpr std::size_t kLanes = hn::MaxLanes(Floats());

/// The channels of kLanes packed colours.
HWY_INLINE void SplitColours(const float* colours, V (&channels)[3]) {
#if HWY_TARGET <= HWY_AVX3
    // What the first vector and the second have of each channel, then what the third has.
    alignas(64) static constexpr std::int32_t kLane[3][2][16] = {
        {{0, 3, 6, 9, 12, 15, 18, 21, 24, 27, 30},
         {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 17, 20, 23, 26, 29}},
        {{1, 4, 7, 10, 13, 16, 19, 22, 25, 28, 31},
         {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 18, 21, 24, 27, 30}},
        {{2, 5, 8, 11, 14, 17, 20, 23, 26, 29},
         {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 16, 19, 22, 25, 28, 31}},
    };
    const auto of = [](const V& a, const std::int32_t* lanes, const V& b) HWY_ATTR {
        return V{_mm512_permutex2var_ps(a.raw, hn::Load(Ints(), lanes).raw, b.raw)};
    };
    const Floats d;
    const V first = hn::LoadU(d, colours);
    const V second = hn::LoadU(d, colours + 16);
    const V third = hn::LoadU(d, colours + 32);
    for (int c = 0; c < 3; ++c)
        channels[c] = of(of(first, kLane[c][0], second), kLane[c][1], third);
#else
    hn::LoadInterleaved3(Floats(), colours, channels[0], channels[1], channels[2]);
#endif
}

/// The channels of up to kLanes packed colours; zeros in the lanes that no colour fills.
HWY_INLINE void LoadColours(const float* colours, std::size_t count, V (&channels)[3]) {
    if (count < kLanes) {
        float padded[3 * kLanes] = {};
        std::copy_n(colours, 3 * count, padded);
        SplitColours(padded, channels);
    } else {
        SplitColours(colours, channels);
    }
}

HWY_INLINE void StoreColours(const V (&channels)[3], float* colours, std::size_t count) {
    if (count < kLanes) {
        float padded[3 * kLanes];
        hn::StoreInterleaved3(channels[0], channels[1], channels[2], Floats(), padded);
        std::copy_n(padded, 3 * count, colours);
    } else {
        hn::StoreInterleaved3(channels[0], channels[1], channels[2], Floats(), colours);
    }
}

/// Sends packed colours through a function that changes their channels, kLanes colours at once.
template <class Change>
HWY_INLINE void forEachVector(const float* in, float* out, std::size_t count, Change change) {
    for (std::size_t i = 0; i < count; i += kLanes) {
        V channels[3];
        LoadColours(in + 3 * i, count - i, channels);
        change(channels);
        StoreColours(channels, out + 3 * i, count - i);
    }
}

/// v, but 0 in lanes that are below 0 or not a number.
HWY_INLINE V NotBelowZero(V v) {
    return hn::IfThenElseZero(hn::Ge(v, hn::Zero(Floats())), v);
}

}  // namespace Orlith::LUT::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#endif  // ORLITH_HAS_VECTORS
#endif  // include guard
