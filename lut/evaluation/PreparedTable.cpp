#include "lut/evaluation/PreparedTable.h"

#include <algorithm>
#include <cmath>
#include <new>
#include <optional>

#include "lut/Interpolation.h"
#include "lut/evaluation/CurveVectors.h"
#include "lut/evaluation/LatticeVectors.h"
#include "lut/evaluation/Placement.h"

namespace Orlith::LUT {
namespace {

using Method = Evaluator::Method;
using Outside = Evaluator::Outside;

/// Colours that go from one step to the next together: they stay in the nearest cache.
constexpr std::size_t kChunk = 512;

class PreLUT {
public:
    explicit PreLUT(const LUT& table)
        : input_(columns(table.inputShaper, true)), output_(columns(table.outputShaper, false)) {}

    /// Whether what the table has could be laid out.
    bool isWhole(const LUT& table) const {
        return input_.has_value() != table.inputShaper.empty() &&
               output_.has_value() != table.outputShaper.empty();
    }

    bool isEmpty() const { return !input_ && !output_; }

    /// LUT::applyShaper for up to kChunk colours.
    /// @return the points behind it: `room`, or the colours themselves when there are no shapers
    const float* apply(const float* colours, float* room, std::size_t count) const {
        const float* points = colours;
        if (input_) {
            curveVectors()->locate(*input_, points, room, count);
            points = room;
        }
        if (output_) {
            curveVectors()->interpolate(*output_, points, room, count);
            points = room;
        }
        return points;
    }

private:
    static std::optional<CurveColumns> columns(const Shaper& shaper, bool search) {
        if (shaper.empty()) return std::nullopt;
        return toColumns(shaper.entries.data(), shaper.entries.size(), shaper.counts, search);
    }

    std::optional<CurveColumns> input_;
    std::optional<CurveColumns> output_;
};

/// Sends colours through the pre-LUT, and the points behind it on, in chunks.
template <class Evaluate>
void forEachChunk(const PreLUT& preLUT, const float* rgbIn, float* rgbOut, std::size_t colourCount,
                  Evaluate evaluate) {
    float room[3 * kChunk];
    for (std::size_t done = 0; done < colourCount; done += kChunk) {
        const std::size_t count = std::min(kChunk, colourCount - done);
        const float* const points = preLUT.apply(rgbIn + 3 * done, room, count);
        evaluate(points, rgbOut + 3 * done, count);
    }
}

class PreparedLattice final : public PreparedTable {
public:
    PreparedLattice(const LUT& table, PreLUT preLUT, const Lattice& lattice, Method method,
                    Outside outside)
        : table_(table),
          preLUT_(std::move(preLUT)),
          lattice_(lattice, method == Method::Cubic ? PaddedLattice::Layout::Lines
                                                    : PaddedLattice::Layout::Samples),
          placement_(table),
          method_(static_cast<std::size_t>(method)),
          outside_(outside) {
        table.minmax(min_, max_);
    }

    void apply(const float* rgbIn, float* rgbOut, std::size_t colourCount) const override {
        const LatticeVectorMethod method = (*latticeVectors())[method_];
        const auto clamp = [&](const float* points, float* results, std::size_t count) {
            method(lattice_, placement_, points, results, count);
        };
        const auto extrapolate = [&](const float* points, float* results, std::size_t count) {
            float room[3 * kChunk];  // the points are still needed, and may be where results go
            clamp(points, room, count);
            replaceOutside(points, room, count);
            std::copy_n(room, 3 * count, results);
        };
        if (outside_ == Outside::Clamp && preLUT_.isEmpty()) {
            clamp(rgbIn, rgbOut, colourCount);
        } else if (outside_ == Outside::Clamp) {
            forEachChunk(preLUT_, rgbIn, rgbOut, colourCount, clamp);
        } else {
            forEachChunk(preLUT_, rgbIn, rgbOut, colourCount, extrapolate);
        }
    }

private:
    void replaceOutside(const float* points, float* results, std::size_t count) const {
        static constexpr InterpolationMethod kMethods[] = {
            StepInterpolate, LinearStaggeredInterpolate, TrilinearInterpolate,
            TetrahedralInterpolate, CubicInterpolate};
        for (std::size_t i = 0; i < 3 * count; i += 3) {
            bool isInside = true;
            for (unsigned c = 0; c < 3; ++c)
                isInside = isInside && min_[c] <= points[i + c] && points[i + c] <= max_[c];
            if (isInside) continue;
            interpolateOrContinue(table_, RGB(points + i), kMethods[method_]).copy_out(results + i);
        }
    }

    const LUT& table_;
    PreLUT preLUT_;
    PaddedLattice lattice_;
    Placement placement_;
    std::size_t method_;
    Outside outside_;
    RGB min_;
    RGB max_;
};

class PreparedCurve final : public PreparedTable {
public:
    PreparedCurve(const LUT& table, PreLUT preLUT, CurveColumns curve, Outside outside)
        : preLUT_(std::move(preLUT)),
          curve_(std::move(curve)),
          placement_(table, outside == Outside::Clamp) {}

    void apply(const float* rgbIn, float* rgbOut, std::size_t colourCount) const override {
        const auto evaluate = [&](const float* points, float* results, std::size_t count) {
            float places[3 * kChunk];
            for (std::size_t i = 0; i < 3 * count; i += 3) {
                for (unsigned c = 0; c < 3; ++c)
                    places[i + c] = placement_(c, points[i + c]);
            }
            curveVectors()->interpolate(curve_, places, results, count);
        };
        forEachChunk(preLUT_, rgbIn, rgbOut, colourCount, evaluate);
    }

private:
    PreLUT preLUT_;
    CurveColumns curve_;
    CurvePlacement placement_;
};

bool suitsCubicVectors(const LUT& table) {
    const float* const end = table.data() + table.dataSize() / sizeof(float);
    return std::all_of(table.data(), end,
                       [](float sample) { return std::fabs(sample) <= kMostForCubicVectors; });
}

std::unique_ptr<const PreparedTable> prepareLattice(const LUT& table, PreLUT preLUT, Method method,
                                                    Outside outside) {
    const Lattice lattice(table);
    if (PaddedLattice::sampleCount(lattice) > PaddedLattice::kMostSamples) return nullptr;
    if (method == Method::Cubic && !suitsCubicVectors(table)) return nullptr;
    if (outside == Outside::Extrapolate && !Placement(table).holdsDomain) return nullptr;
    return std::make_unique<PreparedLattice>(table, std::move(preLUT), lattice, method, outside);
}

std::unique_ptr<const PreparedTable> prepareCurve(const LUT& table, PreLUT preLUT,
                                                  Outside outside) {
    const auto points = static_cast<float>(table.width());
    auto curve = toColumns(&table.get(0), static_cast<std::size_t>(table.width()),
                           RGB(points, points, points), false);
    if (!curve) return nullptr;
    return std::make_unique<PreparedCurve>(table, std::move(preLUT), std::move(*curve), outside);
}

}  // namespace

std::unique_ptr<const PreparedTable> PreparedTable::make(const LUT& table, Method method,
                                                         Outside outside) try {
    if (!latticeVectors() || !curveVectors() || table.data() == nullptr) return nullptr;
    PreLUT preLUT(table);
    if (!preLUT.isWhole(table)) return nullptr;
    return table.is1D() ? prepareCurve(table, std::move(preLUT), outside)
                        : prepareLattice(table, std::move(preLUT), method, outside);
} catch (const std::bad_alloc&) {
    return nullptr;
}

}  // namespace Orlith::LUT
