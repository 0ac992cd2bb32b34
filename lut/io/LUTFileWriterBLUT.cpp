// Binary LUT (.blut); BLUTLayout.h has the drawing.

#include "lut/io/LUTFileWriterBLUT.h"

#include <cstring>
#include <memory>

#include "lut/Exception.h"
#include "lut/io/BLUTLayout.h"
#include "lut/io/Lattice.h"

namespace Orlith::LUT {
namespace {

void writeFloat(std::FILE* file, float value) {
    std::uint32_t bits;
    std::memcpy(&bits, &value, sizeof(bits));
    writeBigEndian(file, bits);
}

void writeHeader(std::FILE* file, int width) {
    std::fwrite(kBLUTMagic, 1, sizeof(kBLUTMagic), file);
    for (const std::uint32_t word : {2U, 5U, 64U})
        writeBigEndian(file, word);
    for (int channel = 0; channel < 3; ++channel) {
        writeFloat(file, 0.0F);
        writeFloat(file, 1.0F);
    }
    // Deliberate: the width modulo 256, unchecked; a table too large for the format is written and
    // does not read back. Held by BLUTWriter.WritesTheWidthModulo256.
    writeBigEndian(file, static_cast<std::uint32_t>(width) & 0xFF);
    std::fputc(kBLUTFloats, file);
}

void writeSamples(std::FILE* file, const LUT& lut, const LatticeSize& size) {
    const float* const samples = lut.data();
    forEachRedFastest(size, [&](std::size_t element) {
        for (std::size_t c = 0; c < 3; ++c)
            writeFloat(file, samples[3 * element + c]);
    });
}

}  // namespace

void LUTFileWriterBLUT::write(const std::string& filename, const boost::shared_ptr<LUT>& lut) {
    // A curve is refused here: it has no height.
    const LatticeSize size = LatticeSize::of(*lut);
    if (!lut->is1D() && !size.isCube()) {
        throw Exception("unable to write: must have the same dimension in r, g and b");
    }
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> file(std::fopen(filename.c_str(), "wb"),
                                                               std::fclose);
    if (!file) throw Exception("unable to open file for writing");
    writeHeader(file.get(), size.width);
    writeSamples(file.get(), *lut, size);
}

}  // namespace Orlith::LUT
