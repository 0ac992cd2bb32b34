// Binary LUT (.blut); BLUTLayout.h has the drawing.

#include "lut/io/LUTFileWriterBLUT.h"

#include <algorithm>
#include <boost/endian/conversion.hpp>
#include <cstring>
#include <iterator>
#include <vector>

#include "lut/Exception.h"
#include "lut/io/BLUTLayout.h"
#include "lut/io/Lattice.h"
#include "lut/io/OutputFile.h"
#include "lut/io/interchange/BLUTInterchange.h"

namespace Orlith::LUT {
namespace {

void writeWord(OutputFile& file, std::uint32_t word) {
    boost::endian::native_to_big_inplace(word);
    char bytes[sizeof(word)];
    std::memcpy(bytes, &word, sizeof(word));
    file.write(bytes, sizeof(bytes));
}

void writeFloats(OutputFile& file, const float* values, std::size_t count) {
    constexpr std::size_t kBlockFloats = 16384;
    std::vector<std::uint32_t> words;
    for (std::size_t start = 0; start < count; start += kBlockFloats) {
        words.resize(std::min(kBlockFloats, count - start));
        const std::size_t byteCount = words.size() * sizeof(float);
        std::memcpy(words.data(), values + start, byteCount);
        for (std::uint32_t& word : words)
            boost::endian::native_to_big_inplace(word);
        file.write(reinterpret_cast<const char*>(words.data()), byteCount);
    }
}

void writeHeader(OutputFile& file, int width, const Range& range) {
    file.write(kBLUTMagic, sizeof(kBLUTMagic));
    for (const std::uint32_t word : {2U, 5U, 64U})
        writeWord(file, word);
    for (unsigned c = 0; c < 3; ++c) {
        const float ends[] = {range.min[c], range.max[c]};
        writeFloats(file, ends, std::size(ends));
    }
    // Deliberate: the width modulo 256, unchecked; a table too large for the format is written and
    // does not read back. Held by BLUTWriter.WritesTheWidthModulo256.
    writeWord(file, static_cast<std::uint32_t>(width) & 0xFF);
    const char type = kBLUTFloats;
    file.write(&type, 1);
}

}  // namespace

void LUTFileWriterBLUT::write(const std::string& filename, const boost::shared_ptr<LUT>& lut) {
    // A curve is refused here: it has no height.
    const LatticeSize size = LatticeSize::of(*lut);
    if (!lut->is1D() && !size.isCube()) {
        throw Exception("unable to write: must have the same dimension in r, g and b");
    }
    const Range range = isInterchange() ? rangeOfBLUT(*lut) : Range{{0, 0, 0}, {1, 1, 1}};
    OutputFile file(filename, wroteAll_);
    writeHeader(file, size.width, range);
    writeFloats(file, lut->data(), 3 * size.pointCount());  // storage has the file's order
}

}  // namespace Orlith::LUT
