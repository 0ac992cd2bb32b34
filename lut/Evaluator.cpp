#include "lut/Evaluator.h"

#include <atomic>
#include <boost/smart_ptr/make_shared.hpp>
#include <cassert>
#include <memory>
#include <mutex>
#include <utility>

#include "lut/CurveLookup.h"
#include "lut/Interpolation.h"
#include "lut/evaluation/LatticeMethods.h"
#include "lut/evaluation/Placement.h"
#include "lut/evaluation/PreparedTable.h"

namespace Orlith::LUT {
namespace {

RGB lookUp(const LUT& curve, const CurvePlacement& placement, const RGB& point) {
    const int sampleCount = curve.width();
    RGB result;
    for (unsigned c = 0; c < 3; ++c) {
        result[c] = interpolateCurve(&curve.get(0), static_cast<std::size_t>(sampleCount), c,
                                     static_cast<float>(sampleCount), placement(c, point[c]));
    }
    return result;
}

/// One colour after the other, with the table as it is.
void applyPlainly(const LUT& table, Evaluator::Method method, Evaluator::Outside outside,
                  const float* rgbIn, float* rgbOut, std::size_t colourCount) {
    const auto forEach = [&](auto evaluate) {
        for (std::size_t i = 0; i < 3 * colourCount; i += 3)
            evaluate(table.applyShaper(RGB(rgbIn + i))).copy_out(rgbOut + i);
    };
    const bool clamps = outside == Evaluator::Outside::Clamp;
    if (table.data() == nullptr) {
        forEach([](const RGB&) { return RGB(0.0F, 0.0F, 0.0F); });
    } else if (table.is1D()) {
        const CurvePlacement placement(table, clamps);
        forEach([&](const RGB& point) { return lookUp(table, placement, point); });
    } else if (clamps) {
        static constexpr RGB (*kMethods[])(const Lattice&, const LatticePosition&) = {
            stepAt, staggeredAt, trilinearAt, tetrahedralAt, cubicAt};
        const auto evaluate = kMethods[static_cast<int>(method)];
        const Lattice lattice(table);
        const Placement placement(table);
        forEach([&](const RGB& point) { return evaluate(lattice, placement(point)); });
    } else {
        static constexpr InterpolationMethod kMethods[] = {
            StepInterpolate, LinearStaggeredInterpolate, TrilinearInterpolate,
            TetrahedralInterpolate, CubicInterpolate};
        const InterpolationMethod evaluate = kMethods[static_cast<int>(method)];
        forEach([&](const RGB& point) { return interpolateOrContinue(table, point, evaluate); });
    }
}

}  // namespace

/// The table's copy, made when so many colours were seen that it pays.
struct Evaluator::Preparation {
    std::atomic<std::size_t> coloursSeen{0};
    std::once_flag once;
    std::unique_ptr<const PreparedTable> table;
};

Evaluator::Evaluator(boost::shared_ptr<const LUT> table, Method method, Outside outside)
    : table_(std::move(table)),
      method_(method),
      outside_(outside),
      preparation_(boost::make_shared<Preparation>()) {
    assert(table_);
}

void Evaluator::apply(const float* rgbIn, float* rgbOut, std::size_t colourCount) const {
    // Copying a sample takes a twelfth (33 points a side) to a third (129) of what a colour takes
    // without the copy.
    constexpr std::size_t kFew = 64;
    const std::size_t pays = kFew + table_->dataSize() / sizeof(RGB) / 8;
    Preparation& preparation = *preparation_;
    const PreparedTable* prepared = nullptr;
    if (preparation.coloursSeen.fetch_add(colourCount) + colourCount > pays) {
        std::call_once(preparation.once, [&] {
            preparation.table = PreparedTable::make(*table_, method_, outside_);
        });
        prepared = preparation.table.get();
    }
    if (prepared) {
        prepared->apply(rgbIn, rgbOut, colourCount);
    } else {
        applyPlainly(*table_, method_, outside_, rgbIn, rgbOut, colourCount);
    }
}

}  // namespace Orlith::LUT
