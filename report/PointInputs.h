#pragma once

#include "lut/evaluation/Look.h"
#include "report/Lines.h"

namespace report {

/// The inputs that the points of a table stand for.
class PointInputs {
public:
    /// Behind a pre-LUT, finds for each point what the pre-LUT sends there: the first place where
    /// it reaches the point, or its last input where it never does.
    explicit PointInputs(const Orlith::LUT::LUT& lut);

    Orlith::LUT::RGB at(const Point& point) const;

    /// Those along each channel, by their index.
    const Orlith::LUT::ChannelInputs& along() const { return inputs_; }

private:
    Orlith::LUT::ChannelInputs inputs_;
};

}  // namespace report
