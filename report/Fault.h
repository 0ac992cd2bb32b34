#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "lut/RGB.h"

namespace report {

/// What can be wrong with a table. Limits are parts of the largest extent (largest less smallest
/// finite sample) that a channel of the table has, so that tables of any range are judged alike.
enum class FaultKind {
    NotFinite,  ///< samples that are NaN or infinite
    Fold,       ///< a channel turns back along its own axis
    Jump,       ///< a step between two points that leaves the steps around it far behind
    Clip,       ///< a channel stays at 0, 1 or its range's end, along the neutral or its own axis
    Tint        ///< neutral inputs whose outputs are not neutral
};

struct Fault {
    FaultKind kind = FaultKind::NotFinite;
    /// Those concerned; of a tint, those that are too strong.
    std::array<bool, 3> channels = {false, false, false};
    /// The inputs between which it is, or where it is largest; the same one for a single place.
    Orlith::LUT::RGB from = Orlith::LUT::RGB(0.0F, 0.0F, 0.0F);
    Orlith::LUT::RGB to = Orlith::LUT::RGB(0.0F, 0.0F, 0.0F);
    /// Fold: how far the output turns back. Jump: by how much the step exceeds those around it.
    /// Clip: the part of the axis, 0 to 1. Tint: strongest less weakest channel. In units of the
    /// output where nothing else is said; infinite for NotFinite.
    double amount = 0.0;
    float level = 0.0F;  ///< of a clip: the output
    /// NotFinite: samples. Fold, Jump: rows of points along an axis, there or in parts of the
    /// lattice that touch each other; of the eighth jump, also those of all further places.
    /// Otherwise 1.
    std::uint64_t count = 1;
};

/// "fold", "jump", "clip", "tint" or "not finite".
const char* nameOf(FaultKind kind);

/// A fault as a sentence without its full stop, such as
/// "red folds back by 0.12 from 0.5 0 0 to 0.5625 0 0, in 289 rows of points".
std::string textOf(const Fault& fault);

}  // namespace report
