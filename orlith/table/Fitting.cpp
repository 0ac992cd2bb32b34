#include "orlith/table/Fitting.h"

#include <fmt/format.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <vector>

#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "orlith/Command.h"
#include "orlith/table/Look.h"
#include "orlith/table/TableFile.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

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
};

// clang-format off
constexpr Capacity kCapacities[] = {
    //         curves unequal points input  output domain
    {".cube",  true,  false,  0,     false, false, true},
    {".csp",   true,  true,   0,     true,  true,  true},
    {".3dl",   false, false,  65,    false, false, false},
    {".cms",   false, false,  0,     false, true,  false},
    {".cub",   false, true,   0,     false, true,  false},
    {".blut",  false, false,  127,   false, false, true},
    {".vf",    false, false,  0,     false, false, false},
    {".vfz",   false, false,  0,     false, false, false},
    {".gz",    false, false,  0,     false, false, false},
};
// clang-format on

const Capacity& capacityOf(const std::string& extension) {
    return *std::find_if(std::begin(kCapacities), std::end(kCapacities),
                         [&](const Capacity& each) { return each.extension == extension; });
}

bool isUnit(const Domain& domain) {
    // A reader's 1 / (N - 1), times N - 1, may miss 1 by a rounding or two.
    constexpr float kNearly = 1e-6F;
    for (unsigned c = 0; c < 3; ++c) {
        if (domain.min[c] != 0.0F || !(std::fabs(domain.max[c] - 1.0F) <= kNearly)) return false;
    }
    return true;
}

bool isUnitDomain(const ol::LUT& lut) {
    Domain domain;
    lut.minmax(domain.min, domain.max);
    return isUnit(domain);
}

bool hasEqualSides(const ol::LUT& lut) {
    return lut.is1D() || (lut.width() == lut.height() && lut.height() == lut.depth());
}

std::string domainText(const Domain& domain) {
    return fmt::format("{:.6g} {:.6g} {:.6g} to {:.6g} {:.6g} {:.6g}", domain.min[0], domain.min[1],
                       domain.min[2], domain.max[0], domain.max[1], domain.max[2]);
}

/// Why a format cannot hold a table as it is; empty if it can.
std::string whyNot(const ol::LUT& lut, const Capacity& capacity) {
    if (lut.is1D() && !capacity.holdsCurves) return "a curve";
    if (!hasEqualSides(lut) && !capacity.holdsUnequalSides) return "unequal sides";
    if (capacity.mostPoints > 0 && lut.width() > capacity.mostPoints) return "too many points";
    if (!lut.inputShaper.empty() && !capacity.holdsInputShaper) return "a shaper";
    if (!lut.outputShaper.empty() && !capacity.holdsOutputShaper) return "a shaper";
    // Behind a shaper that leads to lattice units the points are their own places.
    const bool isBehindShaper = !lut.outputShaper.empty() && capacity.holdsOutputShaper;
    if (!isUnitDomain(lut) && !capacity.holdsDomain && !isBehindShaper) return "its domain";
    return "";
}

int largestSide(const ol::LUT& lut) {
    return lut.is1D() ? lut.width() : std::max({lut.width(), lut.height(), lut.depth()});
}

int sizeOf(const ol::LUT& lut, const Capacity& capacity, bool staysCurve, int wanted) {
    if (wanted > 0) return wanted;
    int size = largestSide(lut);
    if (lut.is1D()) size = staysCurve ? std::max(size, kEntriesForCurves) : kSizeForCurves;
    return capacity.mostPoints > 0 ? std::min(size, capacity.mostPoints) : size;
}

void setDomain(ol::LUT& lut, const Domain& domain, int size) {
    if (isUnit(domain)) return ol::setUnitDomain(lut, size, size, size);
    lut.transform.set_identity();
    for (unsigned c = 0; c < 3; ++c) {
        lut.transform[c][c] = (domain.max[c] - domain.min[c]) / static_cast<float>(size - 1);
        lut.transform[3][c] = domain.min[c];
    }
}

boost::shared_ptr<ol::LUT> resample(const boost::shared_ptr<ol::LUT>& lut, const Domain& domain,
                                    bool staysCurve, int size) {
    boost::shared_ptr<ol::LUT> made;
    if (staysCurve) {
        made = boost::make_shared<ol::LUT1D>();
    } else {
        made = boost::make_shared<ol::LUT3D>();
    }
    made->resize(size);
    setDomain(*made, domain, size);
    // The inputs first, in the samples' own places; then all through the table at once.
    float* next = made->data();
    forEachInput(*made, false,
                 [&](const ol::RGB& colour) { next = std::copy_n(colour.data_block(), 3, next); });
    const ol::Evaluator evaluator(lut);
    evaluator.apply(made->data(), made->data(), pointCount(*made));
    return made;
}

}  // namespace

std::string whyNotHeld(const ol::LUT& lut, const std::string& extension) {
    return whyNot(lut, capacityOf(extension));
}

bool takesRamp(const std::string& extension) {
    const Capacity& capacity = capacityOf(extension);
    return capacity.holdsOutputShaper && !capacity.holdsInputShaper;
}

Fitted fit(const boost::shared_ptr<ol::LUT>& lut, const std::string& extension, int size) {
    const Capacity& capacity = capacityOf(extension);
    Fitted fitted{lut, whyNot(*lut, capacity), ""};
    const bool staysCurve = lut->is1D() && capacity.holdsCurves;
    const bool isOtherSize = size > 0 && (size != lut->width() || !hasEqualSides(*lut));
    if (fitted.whyResampled.empty() && !isOtherSize) return fitted;
    if (fitted.whyResampled.empty()) fitted.whyResampled = "another size";
    if (capacity.mostPoints > 0 && size > capacity.mostPoints) {
        throw Failure(fmt::format("a {} file holds at most {} points a side", extension,
                                  capacity.mostPoints));
    }

    const Domain own = domainOf(*lut);
    Domain domain = own;
    if (!capacity.holdsDomain) {
        domain.min.fill(0.0F);
        domain.max.fill(1.0F);
    }
    for (unsigned c = 0; c < 3; ++c) {
        if (own.min[c] < domain.min[c] - 1e-6F || own.max[c] > domain.max[c] + 1e-6F) {
            fitted.domainChange = fmt::format("from {} to {}", domainText(own), domainText(domain));
        }
    }
    fitted.lut = resample(lut, domain, staysCurve, sizeOf(*lut, capacity, staysCurve, size));
    return fitted;
}

}  // namespace orlith
