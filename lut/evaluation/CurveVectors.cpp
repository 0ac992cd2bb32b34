// The functions of CurveLookup.cpp for many colours at once, in the same order of operations and
// without fused multiply-adds, so that every bit is the same.

#include "lut/evaluation/CurveVectors.h"

#include <cstdint>
#include <limits>

#include "lut/FloatToInt.h"

#undef HWY_TARGET_INCLUDE
#define HWY_TARGET_INCLUDE "lut/evaluation/CurveVectors.cpp"
#include <hwy/foreach_target.h>

#include "lut/evaluation/Colours-inl.h"

HWY_BEFORE_NAMESPACE();
namespace Orlith::LUT::HWY_NAMESPACE {
namespace {

#if ORLITH_HAS_VECTORS

void interpolate(const CurveColumns& curves, const float* in, float* out, std::size_t count) {
    forEachVector(in, out, count, [&](V(&channels)[3]) HWY_ATTR {
        const Floats d;
        const Ints di;
        for (unsigned c = 0; c < 3; ++c) {
            const std::vector<float>& column = curves.values[c];
            const V last = hn::Set(d, static_cast<float>(column.size() - 1));
            const V x = hn::Mul(channels[c], last);
            const V lower = hn::Floor(x);
            const V cell = hn::Min(NotBelowZero(lower), hn::Sub(last, hn::Set(d, 1.0F)));
            const VI i = hn::ConvertTo(di, cell);
            const V a = hn::GatherIndex(d, column.data(), i);
            const V b = hn::GatherIndex(d, column.data() + 1, i);
            const V weight = hn::Sub(x, hn::ConvertTo(d, i));
            V result = hn::Add(a, hn::Mul(hn::Sub(b, a), weight));
            result = hn::IfThenElse(hn::Lt(lower, hn::Zero(d)), hn::Set(d, column.front()), result);
            channels[c] = hn::IfThenElse(hn::Ge(lower, last), hn::Set(d, column.back()), result);
        }
    });
}

void locate(const CurveColumns& curves, const float* in, float* out, std::size_t count) {
    forEachVector(in, out, count, [&](V(&channels)[3]) HWY_ATTR {
        const Floats d;
        const Ints di;
        for (unsigned c = 0; c < 3; ++c) {
            const std::vector<float>& column = curves.values[c];
            const std::vector<float>& rising = curves.rising[c];
            const auto cells = static_cast<std::int32_t>(column.size() - 1);
            const V value = channels[c];
            // Counts the inner points before the first one that is larger.
            VI i = hn::Zero(di);
            for (std::size_t step = (rising.size() + 1) / 2; step > 0; step /= 2) {
                const V probe = hn::GatherIndex(d, rising.data() + step - 1, i);
                const VI further = hn::Set(di, static_cast<std::int32_t>(step));
                const auto isLarger = hn::RebindMask(di, hn::Gt(probe, value));
                i = hn::Add(i, hn::IfThenZeroElse(isLarger, further));
            }
            i = hn::Min(i, hn::Set(di, cells - 1));
            const V below = hn::GatherIndex(d, column.data(), i);
            const V above = hn::GatherIndex(d, column.data() + 1, i);
            const V share = hn::Div(hn::Sub(value, below), hn::Sub(above, below));
            V place =
                hn::Div(hn::Add(hn::ConvertTo(d, i), share), hn::Set(d, static_cast<float>(cells)));
            const V one = hn::Set(d, 1.0F);
            place = hn::IfThenElse(hn::Ge(value, hn::Set(d, column.back())), one, place);
            const auto isBelow = hn::Ge(hn::Set(d, column.front()), value);
            channels[c] = hn::IfThenZeroElse(isBelow, place);
        }
    });
}

const CurveVectors* vectors() {
    static constexpr CurveVectors kVectors = {interpolate, locate};
    return &kVectors;
}

#else

const CurveVectors* vectors() {
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

std::vector<float> risingOf(const std::vector<float>& values) {
    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    std::vector<float> rising;
    float largest = -kInfinity;
    for (std::size_t i = 1; i + 1 < values.size(); ++i) {
        if (values[i] > largest) largest = values[i];
        rising.push_back(largest);
    }
    std::size_t size = 0;
    while (size < rising.size())
        size = 2 * size + 1;
    rising.resize(size, kInfinity);
    return rising;
}

}  // namespace

const CurveVectors* curveVectors() {
    return HWY_DYNAMIC_DISPATCH(vectors)();
}

std::optional<CurveColumns> toColumns(const RGB* entries, std::size_t entryCount, const RGB& counts,
                                      bool search) {
    CurveColumns columns;
    for (unsigned c = 0; c < 3; ++c) {
        // Up to 2^24 points, place and count are whole numbers in single precision.
        constexpr std::int32_t kMostPoints = 1 << 24;
        const std::int32_t points = toInt32(counts[c]);
        if (points < 2 || points > kMostPoints || static_cast<std::size_t>(points) > entryCount ||
            static_cast<float>(points) != counts[c]) {
            return std::nullopt;
        }
        for (std::int32_t i = 0; i < points; ++i)
            columns.values[c].push_back(entries[i][c]);
        if (search) columns.rising[c] = risingOf(columns.values[c]);
    }
    return columns;
}

}  // namespace Orlith::LUT
#endif  // HWY_ONCE
