// The methods of LatticeMethods.cpp for many colours at once, in the same order of operations and
// without fused multiply-adds, so that every bit is the same. Two shapes of vectors occur: one
// channel of kLanes colours, where positions, weights and places are found; and kSamples whole
// samples (r, g, b, 0) side by side, where they are blended. Between the two stand small arrays.

#include "lut/evaluation/LatticeVectors.h"

#include <cmath>
#include <cstdint>

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "lut/evaluation/LatticeVectors.cpp"
#include <hwy/foreach_target.h>

#include "lut/evaluation/Colours-inl.h"

HWY_BEFORE_NAMESPACE();
namespace Orlith::LUT::HWY_NAMESPACE {
namespace {

#if ORLITH_HAS_VECTORS

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

HWY_INLINE void nothing(std::size_t) {}

void step(const PaddedLattice& lattice, const Placement& placement, const float* points,
          float* results, std::size_t count) {
    const Placed placed(lattice, placement);
    const float* const first = lattice.first();
    alignas(64) BlockOf<std::int32_t> places;
    const auto locate = [&](std::size_t i, const V(&point)[3]) HWY_ATTR {
        V index[3];
        for (unsigned c = 0; c < 3; ++c)
            index[c] = hn::Floor(placed.position(c, point[c]));
        hn::Store(placed.place(index), Ints(), places + i);
    };
    const auto blend = [&](std::size_t i) HWY_ATTR { return LoadSamples(first, places + i); };
    forEachBlock(points, results, count, locate, nothing, blend);
}

void trilinear(const PaddedLattice& lattice, const Placement& placement, const float* points,
               float* results, std::size_t count) {
    const Placed placed(lattice, placement);
    const float* const first = lattice.first();
    const std::ptrdiff_t alongR = lattice.stride(0);
    const std::ptrdiff_t alongG = lattice.stride(1);
    const std::ptrdiff_t alongB = lattice.stride(2);
    alignas(64) BlockOf<std::int32_t> places;
    alignas(64) BlockOf<float> weights[3][2];
    const auto locate = [&](std::size_t i, const V(&point)[3]) HWY_ATTR {
        const Floats d;
        const V one = hn::Set(d, 1.0F);
        V lower[3];
        for (unsigned c = 0; c < 3; ++c) {
            const V x = placed.position(c, point[c]);
            lower[c] = hn::Floor(x);
            hn::Store(hn::Add(hn::Sub(lower[c], x), one), d, weights[c][0] + i);
            hn::Store(hn::Add(hn::Sub(x, hn::Add(lower[c], one)), one), d, weights[c][1] + i);
        }
        hn::Store(placed.place(lower), Ints(), places + i);
    };
    const auto blend = [&](std::size_t i) HWY_ATTR {
        V weight[3][2];
        for (unsigned c = 0; c < 3; ++c) {
            for (unsigned side = 0; side < 2; ++side)
                weight[c][side] = SpreadToSamples(weights[c][side] + i);
        }
        V sum = hn::Zero(Floats());
        for (int corner = 0; corner < 8; ++corner) {  // red fastest: the order of the sum is fixed
            const int r = corner & 1;
            const int g = (corner >> 1) & 1;
            const int b = corner >> 2;
            const V sample = LoadSamples(first + r * alongR + g * alongG + b * alongB, places + i);
            sum = hn::Add(
                sum, hn::Mul(hn::Mul(hn::Mul(sample, weight[0][r]), weight[1][g]), weight[2][b]));
        }
        return sum;
    };
    forEachBlock(points, results, count, locate, nothing, blend);
}

void tetrahedral(const PaddedLattice& lattice, const Placement& placement, const float* points,
                 float* results, std::size_t count) {
    const Placed placed(lattice, placement);
    const float* const lowest = lattice.first();
    const float* const highest = lowest + lattice.stride(0) + lattice.stride(1) + lattice.stride(2);
    // Places of the cell's lowest corner, of the one after it on the way, and of the one before the
    // highest, less what lies between lowest and highest.
    alignas(64) BlockOf<std::int32_t> places[3];
    alignas(64) BlockOf<float> weights[4];
    const auto locate = [&](std::size_t i, const V(&point)[3]) HWY_ATTR {
        const Floats d;
        const Ints di;
        V lower[3];
        V f[3];
        for (unsigned c = 0; c < 3; ++c) {
            const V x = placed.position(c, point[c]);
            lower[c] = hn::Floor(x);
            f[c] = hn::Sub(x, lower[c]);
        }
        // Of equal fractions red goes first, then green.
        const auto redBeforeGreen = hn::Ge(f[0], f[1]);
        const auto redBeforeBlue = hn::Ge(f[0], f[2]);
        const auto greenBeforeBlue = hn::Ge(f[1], f[2]);
        const auto choose = [&](auto mask, VI yes, VI no) HWY_ATTR {
            return hn::IfThenElse(hn::RebindMask(di, mask), yes, no);
        };
        const VI firstStep = choose(hn::And(redBeforeGreen, redBeforeBlue), placed.stride(0),
                                    choose(hn::AndNot(redBeforeGreen, greenBeforeBlue),
                                           placed.stride(1), placed.stride(2)));
        const VI lastStep = choose(hn::And(redBeforeBlue, greenBeforeBlue), placed.stride(2),
                                   choose(hn::AndNot(greenBeforeBlue, redBeforeGreen),
                                          placed.stride(1), placed.stride(0)));
        const VI place = placed.place(lower);
        hn::Store(place, di, places[0] + i);
        hn::Store(hn::Add(place, firstStep), di, places[1] + i);
        hn::Store(hn::Sub(place, lastStep), di, places[2] + i);

        const V smallerRG = hn::Min(f[0], f[1]);
        const V largerRG = hn::Max(f[0], f[1]);
        const V largest = hn::Max(largerRG, f[2]);
        const V middle = hn::Max(smallerRG, hn::Min(largerRG, f[2]));
        const V smallest = hn::Min(smallerRG, f[2]);
        hn::Store(hn::Sub(hn::Set(d, 1.0F), largest), d, weights[0] + i);
        hn::Store(hn::Sub(largest, middle), d, weights[1] + i);
        hn::Store(hn::Sub(middle, smallest), d, weights[2] + i);
        hn::Store(smallest, d, weights[3] + i);
    };
    const auto blend = [&](std::size_t i) HWY_ATTR {
        const auto term = [&](int k, const float* samples, const std::int32_t* place) HWY_ATTR {
            return hn::Mul(SpreadToSamples(weights[k] + i), LoadSamples(samples, place + i));
        };
        const V two = hn::Add(term(0, lowest, places[0]), term(1, lowest, places[1]));
        return hn::Add(hn::Add(two, term(2, highest, places[2])), term(3, highest, places[0]));
    };
    forEachBlock(points, results, count, locate, nothing, blend);
}

HWY_INLINE V Mix(V a, V b, V weight) {
    return hn::Add(a, hn::Mul(weight, hn::Sub(b, a)));
}

void staggered(const PaddedLattice& lattice, const Placement& placement, const float* points,
               float* results, std::size_t count) {
    const Placed placed(lattice, placement);
    forEachVector(points, results, count, [&](V(&colour)[3]) HWY_ATTR {
        const Floats d;
        const V half = hn::Set(d, 0.5F);
        V nearest[3];
        V weight[3];
        V own[3];
        VI beside[3];  // the way to the neighbour on the colour's side
        for (unsigned c = 0; c < 3; ++c) {
            const V x = placed.position(c, colour[c]);
            const V lower = hn::Floor(x);
            nearest[c] = hn::IfThenElse(hn::Ge(hn::Sub(x, lower), half),
                                        hn::Add(lower, hn::Set(d, 1.0F)), lower);
            weight[c] = hn::Abs(hn::Sub(x, nearest[c]));
            own[c] = hn::Sub(x, hn::Sub(nearest[c], half));
            beside[c] = hn::IfThenElse(hn::RebindMask(Ints(), hn::Gt(x, nearest[c])),
                                       placed.stride(c), hn::Neg(placed.stride(c)));
        }
        const VI place = placed.place(nearest);
        for (unsigned c = 0; c < 3; ++c) {
            const unsigned inner = c == 2 ? 1 : 2;
            const unsigned outer = c == 0 ? 1 : 0;
            const float* const channel = lattice.first() + c;
            const auto plane = [&](const float* samples) HWY_ATTR {
                const auto line = [&](VI at) HWY_ATTR {
                    return Mix(hn::GatherIndex(d, samples, at),
                               hn::GatherIndex(d, samples, hn::Add(at, beside[inner])),
                               weight[inner]);
                };
                return Mix(line(place), line(hn::Add(place, beside[outer])), weight[outer]);
            };
            colour[c] = Mix(plane(channel), plane(channel + lattice.stride(c)), own[c]);
        }
    });
}

/// t, its square and its cube.
struct Powers {
    V t;
    V t2;
    V t3;
};

HWY_INLINE V CatmullRom(V p0, V p1, V p2, V p3, const Powers& power) {
    const auto times = [](float factor, V v)
                           HWY_ATTR { return hn::Mul(hn::Set(Floats(), factor), v); };
    const V cubic = hn::Add(hn::Sub(hn::Sub(times(3.0F, p1), times(3.0F, p2)), p0), p3);
    const V square =
        hn::Sub(hn::Sub(hn::Add(times(4.0F, p2), times(2.0F, p0)), times(5.0F, p1)), p3);
    const V linear = hn::Sub(p2, p0);
    const V curved = hn::Add(hn::Mul(cubic, power.t3), hn::Mul(square, power.t2));
    return times(0.5F, hn::Add(hn::Add(curved, hn::Mul(linear, power.t)), times(2.0F, p1)));
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

const LatticeVectors* vectors() {
    static constexpr LatticeVectors kVectors = {&step, &staggered, &trilinear, &tetrahedral,
                                                &cubic};
    return &kVectors;
}

#else

const LatticeVectors* vectors() {
    return nullptr;
}

#endif  // ORLITH_HAS_VECTORS

}  // namespace
}  // namespace Orlith::LUT::HWY_NAMESPACE
HWY_AFTER_NAMESPACE();

#if HWY_ONCE
namespace Orlith::LUT {
namespace {

HWY_EXPORT(vectors);

}  // namespace

const LatticeVectors* latticeVectors() {
    return HWY_DYNAMIC_DISPATCH(vectors)();
}

}  // namespace Orlith::LUT
#endif  // HWY_ONCE
