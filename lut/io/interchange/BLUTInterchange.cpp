#include "lut/io/interchange/BLUTInterchange.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <string>

#include "lut/Exception.h"
#include "lut/io/interchange/TextInterchange.h"
#include "lut/io/interchange/WriteChecks.h"

namespace Orlith::LUT {
namespace {

[[noreturn]] void fail(const Reading& reading, const std::string& reason) {
    reading.remarks.addLast(0, reason);
    throw Exception("BLUT LUT reader: syntax error while reading LUT data.");
}

float bigEndianFloat(const unsigned char* bytes) {
    const std::uint32_t bits = std::uint32_t{bytes[0]} << 24 | std::uint32_t{bytes[1]} << 16 |
                               std::uint32_t{bytes[2]} << 8 | std::uint32_t{bytes[3]};
    float value;
    std::memcpy(&value, &bits, sizeof(value));
    return value;
}

Range rangeOf(const BLUTHeaderBytes& header) {
    Range range;
    const unsigned char* ends = header.data() + kBLUTRangeOffset;
    for (unsigned c = 0; c < 3; ++c, ends += 8) {
        range.min[c] = bigEndianFloat(ends);
        range.max[c] = bigEndianFloat(ends + 4);
    }
    return range;
}

}  // namespace

void explainBLUTMagic(const Reading& reading, const BLUTHeaderBytes& header, std::size_t held) {
    const std::string magic(header.begin(), header.begin() + std::min(held, std::size(kBLUTMagic)));
    reading.remarks.addLast(
        0, held == 0 ? "the file is empty" : "the file begins with " + quoted(magic));
}

void expectBLUTSize(const Reading& reading, int size) {
    if (size >= 2) return;
    const std::string points = std::to_string(size < 0 ? size + 256 : size);
    const std::string reason = "a table of " + points + " points a side, where 2 to 127 can be";
    if (reading.isMeant) fail(reading, reason);
    reading.remarks.addLast(0, reason);
}

void finishBLUT(const Reading& reading, const BLUTHeaderBytes& header, LUT& lut) {
    const std::uint64_t points = pointCount(lut);
    const Range range = rangeOf(header);
    if (reading.isMeant) {
        if (reading.sampleCount < points) fail(reading, endsEarly(reading.sampleCount, points));
        if (!rises(range)) fail(reading, "the range in the header does not rise");
        const int size = lut.width();
        setDomain(lut, range, {size, size, size});
        return;
    }
    if (reading.sampleCount < points) {
        reading.remarks.addLast(0, endsEarly(reading.sampleCount, points));
    }
    if (!isUnit(range)) {
        reading.remarks.addLast(0, "the range in the header is not used: the table covers 0 to 1");
    }
}

Range rangeOfBLUT(const LUT& lut) {
    expectDomain(lut);
    expectNoPreLUT(lut);
    if (lut.width() > kBLUTMostPoints) {
        throw Exception("unable to write: the format has no place for more than 127 points a side");
    }
    const Range domain = domainOf(lut);
    return isUnit(domain) ? unitRange() : domain;
}

}  // namespace Orlith::LUT
