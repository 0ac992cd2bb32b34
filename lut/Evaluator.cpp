#include "lut/Evaluator.h"

#include <cassert>
#include <utility>

#include "lut/CurveLookup.h"
#include "lut/Interpolation.h"
#include "lut/LatticeMethods.h"

namespace Orlith::LUT {
namespace {

RGB zero() {
    return RGB(0.0F, 0.0F, 0.0F);
}

/// The last position on each axis. Where dividing the last point's input by the scale rounds
/// upwards, it is that quotient: such a colour is within the domain and evaluated where it falls.
LatticePosition lastPosition(const LUT& lut, const Lattice& lattice) {
    RGB min;
    RGB max;
    lut.minmax(min, max);
    LatticePosition position = latticePosition(lut, max);
    for (unsigned c = 0; c < 3; ++c) {
        const auto last = static_cast<float>(lattice.last(c));
        const bool isRounding = position[c] > last && position[c] < last + 1.0F;
        if (!isRounding) position[c] = last;
    }
    return position;
}

LatticePosition clamped(LatticePosition x, const LatticePosition& last) {
    for (unsigned c = 0; c < 3; ++c) {
        if (!(x[c] >= 0.0F)) x[c] = 0.0F;
        if (x[c] > last[c]) x[c] = last[c];
    }
    return x;
}

RGB tetrahedralInterpolate(const LUT& lut, const RGB& point) {
    return tetrahedralAt(Lattice(lut), latticePosition(lut, point));
}

/// A curve that covers the inputs of its transform, or just 0 to 1.
class Curve {
public:
    Curve(const LUT& lut, bool replaceNaN) : lut_(lut), replaceNaN_(replaceNaN) {}

    RGB operator()(const RGB& point) const {
        const int sampleCount = lut_.width();
        RGB result;
        for (unsigned c = 0; c < 3; ++c) {
            result[c] = interpolateCurve(&lut_.get(0), static_cast<std::size_t>(sampleCount), c,
                                         static_cast<float>(sampleCount), place(c, point[c]));
        }
        return result;
    }

private:
    /// From 0 at the first point to 1 at the last.
    float place(unsigned c, float input) const {
        const auto cells = static_cast<float>(lut_.width() - 1);
        const float scale = lut_.transform[c][c];
        const float offset = lut_.transform[3][c];
        const bool isUnitDomain = scale == 1.0F / cells && offset == 0.0F;
        const float t = isUnitDomain ? input : (input - offset) / (scale * cells);
        return replaceNaN_ && t != t ? 0.0F : t;
    }

    const LUT& lut_;
    bool replaceNaN_;
};

template <class Evaluate>
void forEachColour(const float* rgbIn, float* rgbOut, std::size_t colourCount, Evaluate evaluate) {
    for (std::size_t i = 0; i < 3 * colourCount; i += 3)
        evaluate(RGB(rgbIn[i], rgbIn[i + 1], rgbIn[i + 2])).copy_out(rgbOut + i);
}

}  // namespace

Evaluator::Evaluator(boost::shared_ptr<const LUT> table, Method method, Outside outside)
    : table_(std::move(table)), method_(method), outside_(outside) {
    assert(table_);
}

void Evaluator::apply(const float* rgbIn, float* rgbOut, std::size_t colourCount) const {
    const auto forEach = [&](auto evaluate) {
        forEachColour(rgbIn, rgbOut, colourCount, evaluate);
    };
    const LUT& table = *table_;
    if (table.data() == nullptr) {
        forEach([](const RGB&) { return zero(); });
    } else if (table.is1D()) {
        const Curve curve(table, outside_ == Outside::Clamp);
        forEach([&](const RGB& colour) { return curve(table.applyShaper(colour)); });
    } else if (outside_ == Outside::Extrapolate) {
        static constexpr InterpolationMethod kMethods[] = {
            StepInterpolate, LinearStaggeredInterpolate, TrilinearInterpolate,
            tetrahedralInterpolate, CubicInterpolate};
        const InterpolationMethod method = kMethods[static_cast<int>(method_)];
        forEach([&](const RGB& colour) {
            return interpolateOrContinue(table, table.applyShaper(colour), method);
        });
    } else {
        static constexpr RGB (*kMethods[])(const Lattice&, const LatticePosition&) = {
            stepAt, staggeredAt, trilinearAt, tetrahedralAt, cubicAt};
        const auto method = kMethods[static_cast<int>(method_)];
        const Lattice lattice(table);
        const LatticePosition last = lastPosition(table, lattice);
        forEach([&](const RGB& colour) {
            const RGB point = table.applyShaper(colour);
            return method(lattice, clamped(latticePosition(table, point), last));
        });
    }
}

}  // namespace Orlith::LUT
