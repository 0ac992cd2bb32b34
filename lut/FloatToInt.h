#pragma once

#include <cstdint>
#include <limits>

namespace Orlith::LUT {

/// Cuts a float (or double) to an integer towards zero without overflow: what is too large or too
/// small becomes the largest or smallest integer, NaN becomes 0.
template <class Real>
constexpr std::int32_t toInt32(Real value) noexcept {
    constexpr Real kBeyond = static_cast<Real>(2147483648.0);  // 2^31, exact in both precisions
    if (value != value) return 0;
    if (value >= kBeyond) return std::numeric_limits<std::int32_t>::max();
    if (value < -kBeyond) return std::numeric_limits<std::int32_t>::min();
    return static_cast<std::int32_t>(value);
}

}  // namespace Orlith::LUT
