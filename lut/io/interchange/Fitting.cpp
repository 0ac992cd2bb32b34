#include "lut/io/interchange/Fitting.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <stdexcept>

#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "lut/evaluation/Look.h"
#include "lut/io/BLUTLayout.h"

namespace Orlith::LUT {
namespace {

constexpr int kSizeForCurves = 33;
constexpr int kEntriesForCurves = 4096;  // of a curve whose shapers go into it

/// What the files of a format can hold.
struct Capacity {
    const char* extension;
    bool holdsCurves;
    bool holdsUnequalSides;
    int mostPoints;  // a side; 0: any number
    bool holdsInputShaper;
    bool holdsOutputShaper;
    bool holdsDomain;
    bool holdsAnyNumber;  // also what is not finite
};

// clang-format off
constexpr Capacity kCapacities[] = {
    //         curves unequal points input  output domain any number
    {".cube",  true,  false,  0,     false, false, true,  false},
    {".csp",   true,  true,   0,     true,  true,  true,  false},
    {".3dl",   false, false,  65,    false, false, false, false},
    {".cms",   false, false,  0,     false, true,  false, false},
    {".cub",   false, true,   0,     false, true,  false, false},
    {".blut",  false, false,  kBLUTMostPoints, false, false, true,  true},
    {".vf",    false, false,  0,     false, false, false, false},
    {".vfz",   false, false,  0,     false, false, false, false},
    {".gz",    false, false,  0,     false, false, false, false},
};
// clang-format on

const Capacity& capacityOf(const std::string& extension) {
    for (const Capacity& each : kCapacities) {
        if (each.extension == extension) return each;
    }
    throw std::invalid_argument("no table is written as \"" + extension + "\"");
}

bool hasEqualSides(const LUT& lut) {
    return lut.is1D() || (lut.width() == lut.height() && lut.height() == lut.depth());
}

/// Why a format cannot hold a table as it is; empty if it can.
std::string whyNot(const LUT& lut, const Capacity& capacity) {
    if (lut.is1D() && !capacity.holdsCurves) return "a curve";
    if (!hasEqualSides(lut) && !capacity.holdsUnequalSides) return "unequal sides";
    if (capacity.mostPoints > 0 && lut.width() > capacity.mostPoints) return "too many points";
    if (!lut.inputShaper.empty() && !capacity.holdsInputShaper) return "a shaper";
    if (!lut.outputShaper.empty() && !capacity.holdsOutputShaper) return "a shaper";
    // Behind a shaper that leads to lattice units the points are their own places.
    const bool isBehindShaper = !lut.outputShaper.empty() && capacity.holdsOutputShaper;
    if (!isUnit(domainOf(lut)) && !capacity.holdsDomain && !isBehindShaper) return "its domain";
    return "";
}

bool isFinite(const LUT& lut) {
    return std::all_of(lut.data(), lut.data() + 3 * pointCount(lut),
                       [](float sample) { return std::isfinite(sample); });
}

int largestSide(const LUT& lut) {
    return lut.is1D() ? lut.width() : std::max({lut.width(), lut.height(), lut.depth()});
}

int sizeOf(const LUT& lut, const Capacity& capacity, bool staysCurve, int wanted) {
    if (wanted > 0) return wanted;
    int size = largestSide(lut);
    if (lut.is1D()) size = staysCurve ? std::max(size, kEntriesForCurves) : kSizeForCurves;
    return capacity.mostPoints > 0 ? std::min(size, capacity.mostPoints) : size;
}

boost::shared_ptr<LUT> resample(const boost::shared_ptr<LUT>& lut, const Range& domain,
                                bool staysCurve, int size) {
    boost::shared_ptr<LUT> made;
    if (staysCurve) {
        made = boost::make_shared<LUT1D>();
    } else {
        made = boost::make_shared<LUT3D>();
    }
    made->resize(size);
    setDomain(*made, domain, {size, size, size});
    // The inputs first, in the samples' own places; then all through the table at once.
    float* next = made->data();
    forEachInput(*made, false,
                 [&](const RGB& colour) { next = std::copy_n(colour.data_block(), 3, next); });
    const Evaluator evaluator(lut);
    evaluator.apply(made->data(), made->data(), pointCount(*made));
    return made;
}

}  // namespace

std::string whyNotHeld(const LUT& lut, const std::string& extension) {
    return whyNot(lut, capacityOf(extension));
}

bool takesRamp(const std::string& extension) {
    const Capacity& capacity = capacityOf(extension);
    return capacity.holdsOutputShaper && !capacity.holdsInputShaper;
}

Fitted fit(const boost::shared_ptr<LUT>& lut, const std::string& extension, int size) {
    const Capacity& capacity = capacityOf(extension);
    if (!capacity.holdsAnyNumber && !isFinite(*lut)) {
        throw std::invalid_argument("the table has samples that are not finite, which " +
                                    extension + " files cannot hold");
    }
    Fitted fitted{lut, whyNot(*lut, capacity), false};
    const bool staysCurve = lut->is1D() && capacity.holdsCurves;
    const bool isOtherSize = size > 0 && (size != lut->width() || !hasEqualSides(*lut));
    if (fitted.whyResampled.empty() && !isOtherSize) return fitted;
    if (fitted.whyResampled.empty()) fitted.whyResampled = "another size";
    if (capacity.mostPoints > 0 && size > capacity.mostPoints) {
        throw std::invalid_argument("a " + extension + " file holds at most " +
                                    std::to_string(capacity.mostPoints) + " points a side");
    }

    const Range own = inputRangeOf(*lut);
    const Range domain = !capacity.holdsDomain || isUnit(own) ? unitRange() : own;
    constexpr float kSlack = 1e-6F;  // of a domain, which people would not call smaller
    for (unsigned c = 0; c < 3; ++c) {
        fitted.losesInputs = fitted.losesInputs || own.min[c] < domain.min[c] - kSlack ||
                             own.max[c] > domain.max[c] + kSlack;
    }
    fitted.lut = resample(lut, domain, staysCurve, sizeOf(*lut, capacity, staysCurve, size));
    return fitted;
}

}  // namespace Orlith::LUT
