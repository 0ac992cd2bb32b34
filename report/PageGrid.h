#pragma once

#include <nlohmann/json_fwd.hpp>
#include <string>
#include <vector>

#include "lut/evaluation/Look.h"
#include "report/Page.h"

namespace report {

/// The colours at which a page shows its tables: the points of the larger one, or some of them.
struct PageGrid {
    Orlith::LUT::ChannelInputs inputs;

    /// The colours behind a table, red fastest.
    std::vector<Orlith::LUT::RGB> outputs(const Look& look) const;

    nlohmann::json json() const;
};

PageGrid gridOf(const std::vector<PageTable>& tables);

/// Smallest and largest finite number; 0 and 1 where there is none, and apart by 1 where all are
/// one.
struct Extent {
    float min = 0.0F;
    float max = 1.0F;
};
Extent extentOf(const std::vector<Orlith::LUT::RGB>& colours);

/// Colours as base64 of 16-bit codes: 0 to 65534 from the extent's min to its max, 65535 for what
/// is not finite.
std::string codesOf(const std::vector<Orlith::LUT::RGB>& colours, const Extent& extent);

/// The largest finite distance of two colours at the same place, on any channel.
double largestDistance(const std::vector<Orlith::LUT::RGB>& a,
                       const std::vector<Orlith::LUT::RGB>& b);

}  // namespace report
