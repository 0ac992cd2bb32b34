#include "lut/io/interchange/WriteChecks.h"

#include <cmath>
#include <cstddef>

#include "lut/Exception.h"
#include "lut/evaluation/Range.h"
#include "lut/io/Lattice.h"

namespace Orlith::LUT {

bool isRamp(const Shaper& shaper) {
    constexpr float kPrinted = 1e-6F;  // a step of the six digits in which shapers are written
    const std::size_t entryCount = shaper.entries.size();
    for (unsigned c = 0; c < 3; ++c) {
        const float count = shaper.counts[c];
        if (!(count >= 2.0F && count <= static_cast<float>(entryCount))) return false;
        for (std::size_t i = 0; i < entryCount && static_cast<float>(i) < count; ++i) {
            const float even = static_cast<float>(i) / (count - 1.0F);
            if (!(std::fabs(shaper.entries[i][c] - even) <= kPrinted)) return false;
        }
    }
    return true;
}

void expectDomain(const LUT& lut) {
    const LatticeSize size = lut.is1D() ? LatticeSize{lut.width(), 2, 2} : LatticeSize::of(lut);
    if (size.width < 2 || size.height < 2 || size.depth < 2) {
        throw Exception("unable to write: a side needs at least two points");
    }
    if (!rises(domainOf(lut))) throw Exception("unable to write: the domain does not rise");
}

void expectNoPreLUT(const LUT& lut) {
    for (const Shaper* const shaper : {&lut.inputShaper, &lut.outputShaper}) {
        if (!shaper->empty() && !isRamp(*shaper)) {
            throw Exception("unable to write: the format has no place for the pre-LUT");
        }
    }
}

void expectUnitDomain(const LUT& lut) {
    if (!isUnit(domainOf(lut))) {
        throw Exception("unable to write: the format has no place for a domain but 0 to 1");
    }
}

}  // namespace Orlith::LUT
