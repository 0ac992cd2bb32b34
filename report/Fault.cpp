#include "report/Fault.h"

#include <fmt/format.h>

#include <cmath>

namespace report {
namespace {

std::string colourText(const Orlith::LUT::RGB& colour) {
    // NaN has no sign.
    const auto text = [](float number) {
        return std::isnan(number) ? std::string("nan") : fmt::format("{:.6g}", number);
    };
    return fmt::format("{} {} {}", text(colour[0]), text(colour[1]), text(colour[2]));
}

std::string channelsText(const Fault& fault) {
    constexpr const char* kNames[] = {"red", "green", "blue"};
    std::string text;
    for (unsigned c = 0; c < 3; ++c) {
        if (!fault.channels[c]) continue;
        if (!text.empty()) text += ", ";
        text += kNames[c];
    }
    return text;
}

bool isPlural(const Fault& fault) {
    return fault.channels[0] + fault.channels[1] + fault.channels[2] > 1;
}

std::string placeText(const Fault& fault) {
    if (fault.from == fault.to) return "at " + colourText(fault.from);
    return fmt::format("from {} to {}", colourText(fault.from), colourText(fault.to));
}

std::string rowsText(const Fault& fault) {
    return fault.count == 1 ? "" : fmt::format(", in {} rows of points", fault.count);
}

/// The hue that outputs lean to: red and green too strong are yellow.
const char* hueOf(const Fault& fault) {
    constexpr const char* kHues[] = {"no hue", "red",     "green", "yellow",
                                     "blue",   "magenta", "cyan",  "white"};
    return kHues[fault.channels[0] * 1 + fault.channels[1] * 2 + fault.channels[2] * 4];
}

}  // namespace

const char* nameOf(FaultKind kind) {
    switch (kind) {
        case FaultKind::NotFinite:
            return "not finite";
        case FaultKind::Fold:
            return "fold";
        case FaultKind::Jump:
            return "jump";
        case FaultKind::Clip:
            return "clip";
        case FaultKind::Tint:
            return "tint";
    }
    return "";
}

std::string textOf(const Fault& fault) {
    const std::string channels = channelsText(fault);
    const char* const ending = isPlural(fault) ? "" : "s";
    switch (fault.kind) {
        case FaultKind::NotFinite:
            return fault.count == 1
                       ? fmt::format("1 sample is not finite, at {}", colourText(fault.from))
                       : fmt::format("{} samples are not finite, the first at {}", fault.count,
                                     colourText(fault.from));
        case FaultKind::Fold:
            return fmt::format("{} fold{} back by {:.3g} {}{}", channels, ending, fault.amount,
                               placeText(fault), rowsText(fault));
        case FaultKind::Jump:
            return fmt::format("{} jump{} by {:.3g} {}{}", channels, ending, fault.amount,
                               placeText(fault), rowsText(fault));
        case FaultKind::Clip:
            return fmt::format("{} clip{} at {:.6g} {}", channels, ending, fault.level,
                               placeText(fault));
        case FaultKind::Tint:
            return fmt::format("neutrals lean to {} by {:.3g} at most, {}", hueOf(fault),
                               fault.amount, placeText(fault));
    }
    return "";
}

}  // namespace report
