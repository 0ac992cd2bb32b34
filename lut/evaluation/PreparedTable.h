#pragma once

#include <cstddef>
#include <memory>

#include "lut/Evaluator.h"

namespace Orlith::LUT {

/// A table laid out for many colours, in a copy: the quick way of the Evaluator.
class PreparedTable {
public:
    /// @param table  must stay as it is and outlive the result
    /// @return null when the table is too large to be copied, when the counts of a shaper or a
    /// curve
    ///         are not those of its points, on a processor without vectors, or without memory
    static std::unique_ptr<const PreparedTable> make(const LUT& table, Evaluator::Method method,
                                                     Evaluator::Outside outside);

    virtual ~PreparedTable() = default;

    /// See Evaluator::apply.
    virtual void apply(const float* rgbIn, float* rgbOut, std::size_t colourCount) const = 0;
};

}  // namespace Orlith::LUT
