// Binary LUT (.blut); BLUTLayout.h has the drawing. A file that is too short is read as if zeros
// followed it.

#include "lut/io/LUTFileReaderBLUT.h"

#include <half.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <cstring>
#include <memory>

#include "lut/Exception.h"
#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "lut/io/BLUTLayout.h"
#include "lut/io/interchange/BLUTInterchange.h"

namespace Orlith::LUT {
namespace {

struct Header {
    bool isCurve;
    bool hasHalves;
    int size;  // points along each axis
    BLUTHeaderBytes bytes;
};

Header readHeader(std::FILE* file, const Reading& reading) {
    BLUTHeaderBytes bytes;
    const std::size_t held = std::fread(bytes.data(), 1, bytes.size(), file);
    std::fill(bytes.begin() + held, bytes.end(), static_cast<unsigned char>(0));
    if (!std::equal(std::begin(kBLUTMagic), std::end(kBLUTMagic), bytes.begin())) {
        explainBLUTMagic(reading, bytes, held);
        throw Exception("BLUT LUT reader: unsupported header magic number, expected \"HLUT\".");
    }
    // Deliberate: a signed byte, so that 128 to 255 are negative sizes, which no table takes.
    // Held by BLUTReader.TakesTheSizeForASignedByte.
    return {bytes[kBLUTKindOffset] == kBLUTCurve, bytes[kBLUTTypeOffset] == kBLUTHalves,
            static_cast<std::int8_t>(bytes[kBLUTSizeOffset]), bytes};
}

boost::shared_ptr<LUT> makeTable(const Header& header) {
    auto lut = header.isCurve ? boost::shared_ptr<LUT>(boost::make_shared<LUT1D>())
                              : boost::shared_ptr<LUT>(boost::make_shared<LUT3D>());
    lut->resize(header.size);
    return lut;
}

float halfToFloat(std::uint32_t bits) {
    // The table itself, not half's conversion: where that is done by the processor, it changes
    // some NaNs.
    return imath_half_to_float_table[bits].f;
}

float asFloat(std::uint32_t bits) {
    float value;
    std::memcpy(&value, &bits, sizeof(value));
    return value;
}

/// Both kinds of table are stored in the order of the file.
/// @return samples that the file held to the last byte
template <int kByteCount, float (*kToFloat)(std::uint32_t)>
std::size_t readSamples(std::FILE* file, LUT& lut) {
    float* const values = lut.data();
    const std::size_t valueCount = lut.dataSize() / sizeof(float);
    std::size_t read = 0;
    for (std::uint32_t bits; read < valueCount && readBigEndian<kByteCount>(file, bits); ++read)
        values[read] = kToFloat(bits);
    return read / 3;
}

}  // namespace

boost::shared_ptr<LUT> LUTFileReaderBLUT::read(const std::string& filename) {
    beginRead();
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(std::fopen(filename.c_str(), "rb"),
                                                               std::fclose);
    if (!file) failToOpen("BLUT LUT reader: unable to open file.");

    const Header header = readHeader(file.get(), reading());
    expectBLUTSize(reading(), header.size);
    lut_ = makeTable(header);
    sampleCount_ = header.hasHalves ? readSamples<2, halfToFloat>(file.get(), *lut_)
                                    : readSamples<4, asFloat>(file.get(), *lut_);
    // Whatever range the header says.
    setUnitDomain(*lut_, header.size, header.size, header.size);
    finishBLUT(reading(), header.bytes, *lut_);
    return lut_;
}

}  // namespace Orlith::LUT
