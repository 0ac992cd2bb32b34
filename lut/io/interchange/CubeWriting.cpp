#include "lut/io/interchange/CubeWriting.h"

#include "lut/evaluation/Range.h"
#include "lut/io/interchange/WriteChecks.h"

namespace Orlith::LUT {

void expectHeldByCube(const LUT& lut) {
    expectDomain(lut);
    expectNoPreLUT(lut);
}

void writeCubeDomain(LineWriter& file, const LUT& lut) {
    const Range domain = domainOf(lut);
    if (isUnit(domain)) return;
    file.text("DOMAIN_MIN ").shortestTriple(domain.min.data_block()).endLine();
    file.text("DOMAIN_MAX ").shortestTriple(domain.max.data_block()).endLine();
}

}  // namespace Orlith::LUT
