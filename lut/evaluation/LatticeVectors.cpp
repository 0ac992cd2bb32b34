// The methods of LatticeMethods.cpp for many colours at once, in the same order of operations and
// without fused multiply-adds but where their result is the same, so that every bit is.

#include "lut/evaluation/LatticeVectors.h"

#include <cstddef>
#include <cstdint>

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "lut/evaluation/LatticeVectors.cpp"
#include <hwy/foreach_target.h>

#include "lut/evaluation/CubicVectors-inl.h"
#include "lut/evaluation/LatticeColours-inl.h"

HWY_BEFORE_NAMESPACE();
namespace Orlith::LUT::HWY_NAMESPACE {
namespace {

#if ORLITH_HAS_VECTORS

using PlacedSample = Placed<2>;  // four floats

void step(const PaddedLattice& lattice, const Placement& placement, const float* points,
          float* results, std::size_t count) {
    const PlacedSample placed(lattice, placement);
    const float* const first = lattice.first();
    alignas(64) std::int32_t places[2 * kLanes];
    const auto locate = [&](const V(&point)[3], std::size_t slot) HWY_ATTR {
        V index[3];
        for (unsigned c = 0; c < 3; ++c)
            index[c] = hn::Floor(placed.position(c, point[c]));
        hn::Store(placed.place(index), Ints(), places + slot);
        return nullptr;
    };
    const auto blend = [&](std::nullptr_t, std::size_t slot, std::size_t i)
                           HWY_ATTR { return LoadSamples(first, places + slot + i); };
    forEachLocated(points, results, count, locate, blend);
}

void trilinear(const PaddedLattice& lattice, const Placement& placement, const float* points,
               float* results, std::size_t count) {
    const PlacedSample placed(lattice, placement);
    const float* const first = lattice.first();
    const std::ptrdiff_t alongR = lattice.stride(0);
    const std::ptrdiff_t alongG = lattice.stride(1);
    const std::ptrdiff_t alongB = lattice.stride(2);
    alignas(64) std::int32_t places[2 * kLanes];
    struct Weights {
        V of[3][2];
    };
    const auto locate = [&](const V(&point)[3], std::size_t slot) HWY_ATTR {
        const V one = hn::Set(Floats(), 1.0F);
        V lower[3];
        Weights weights;
        for (unsigned c = 0; c < 3; ++c) {
            const V x = placed.position(c, point[c]);
            lower[c] = hn::Floor(x);
            weights.of[c][0] = hn::Add(hn::Sub(lower[c], x), one);
            weights.of[c][1] = hn::Add(hn::Sub(x, hn::Add(lower[c], one)), one);
        }
        hn::Store(placed.place(lower), Ints(), places + slot);
        return weights;
    };
    const auto blend = [&](const Weights& weights, std::size_t slot, std::size_t i) HWY_ATTR {
        V weight[3][2];
        for (unsigned c = 0; c < 3; ++c) {
            for (unsigned side = 0; side < 2; ++side)
                weight[c][side] = SpreadToSamples(weights.of[c][side], i);
        }
        V sum = hn::Zero(Floats());
        for (int corner = 0; corner < 8; ++corner) {  // red fastest: the order of the sum is fixed
            const int r = corner & 1;
            const int g = (corner >> 1) & 1;
            const int b = corner >> 2;
            const V sample =
                LoadSamples(first + r * alongR + g * alongG + b * alongB, places + slot + i);
            sum = hn::Add(
                sum, hn::Mul(hn::Mul(hn::Mul(sample, weight[0][r]), weight[1][g]), weight[2][b]));
        }
        return sum;
    };
    forEachLocated(points, results, count, locate, blend);
}

void tetrahedral(const PaddedLattice& lattice, const Placement& placement, const float* points,
                 float* results, std::size_t count) {
    const PlacedSample placed(lattice, placement);
    const float* const lowest = lattice.first();
    const float* const highest = lowest + lattice.stride(0) + lattice.stride(1) + lattice.stride(2);
    // Places of the cell's lowest corner, of the one after it on the way, and of the one before the
    // highest, less what lies between lowest and highest.
    alignas(64) std::int32_t places[3][2 * kLanes];
    struct Weights {
        V of[4];
    };
    const auto locate = [&](const V(&point)[3], std::size_t slot) HWY_ATTR {
        const Floats d;
        const Ints di;
        V lower[3];
        V f[3];
        for (unsigned c = 0; c < 3; ++c) {
            const V x = placed.position(c, point[c]);
            lower[c] = hn::Floor(x);
            f[c] = hn::Sub(x, lower[c]);
        }
        const V smallerRG = hn::Min(f[0], f[1]);
        const V largerRG = hn::Max(f[0], f[1]);
        const V largest = hn::Max(largerRG, f[2]);
        const V middle = hn::Max(smallerRG, hn::Min(largerRG, f[2]));
        const V smallest = hn::Min(smallerRG, f[2]);

        // Of equal fractions red goes first, then green.
        const auto choose = [&](auto mask, VI yes, VI no) HWY_ATTR {
            return hn::IfThenElse(hn::RebindMask(di, mask), yes, no);
        };
        const VI firstStep =
            choose(hn::Eq(f[0], largest), placed.stride(0),
                   choose(hn::Eq(f[1], largest), placed.stride(1), placed.stride(2)));
        const VI lastStep =
            choose(hn::Eq(f[2], smallest), placed.stride(2),
                   choose(hn::Eq(f[1], smallest), placed.stride(1), placed.stride(0)));
        const VI place = placed.place(lower);
        hn::Store(place, di, places[0] + slot);
        hn::Store(hn::Add(place, firstStep), di, places[1] + slot);
        hn::Store(hn::Sub(place, lastStep), di, places[2] + slot);
        return Weights{{hn::Sub(hn::Set(d, 1.0F), largest), hn::Sub(largest, middle),
                        hn::Sub(middle, smallest), smallest}};
    };
    const auto blend = [&](const Weights& weights, std::size_t slot, std::size_t i) HWY_ATTR {
        const auto term = [&](int k, const float* samples, const std::int32_t* at) HWY_ATTR {
            return hn::Mul(SpreadToSamples(weights.of[k], i), LoadSamples(samples, at + slot + i));
        };
        const V two = hn::Add(term(0, lowest, places[0]), term(1, lowest, places[1]));
        return hn::Add(hn::Add(two, term(2, highest, places[2])), term(3, highest, places[0]));
    };
    forEachLocated(points, results, count, locate, blend);
}

HWY_INLINE V Mix(V a, V b, V weight) {
    return hn::Add(a, hn::Mul(weight, hn::Sub(b, a)));
}

void staggered(const PaddedLattice& lattice, const Placement& placement, const float* points,
               float* results, std::size_t count) {
    const PlacedSample placed(lattice, placement);
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
