#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>

#include "lut/Evaluator.h"
#include "lut/evaluation/Look.h"

namespace CLI {
class App;
}  // namespace CLI

namespace orlith {

/// How colours go through a table.
struct ColourOptions {
    Orlith::LUT::Evaluator::Method method = Orlith::LUT::Evaluator::Method::Trilinear;
    bool extrapolates = false;

    Orlith::LUT::Evaluator::Outside outside() const;
    Orlith::LUT::Evaluator evaluator(const boost::shared_ptr<const Orlith::LUT::LUT>& table) const;

    /// The library's own mode of that name.
    /// @throws UsageError  it has none: tetrahedral
    Orlith::LUT::InterpolationMode bookMode() const;
};

using Orlith::LUT::ColourWay;

/// The way through a table: as its maker means it, or by the book.
/// @throws UsageError  by the book there is no tetrahedral method
ColourWay wayThrough(const boost::shared_ptr<const Orlith::LUT::LUT>& table,
                     const ColourOptions& options, bool isStrict);

void addColourOptions(CLI::App& command, ColourOptions& options);

}  // namespace orlith
