// Any bytes through the gzip stream, with input buffers of any size, and a character put back now
// and then.

#include <cstdint>
#include <sstream>
#include <string>

#include "lut/io/zlib_stream/zip_istream.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t byteCount) {
    std::istringstream source(std::string(reinterpret_cast<const char*>(bytes), byteCount));
    const unsigned shape = byteCount > 0 ? bytes[byteCount - 1] : 0;
    zlib_stream::zip_istream stream(source, 15, 5 + 16 * (shape % 16), 1 + 8 * (shape / 16));
    char block[61];
    for (int round = 0; stream.read(block, sizeof block); ++round) {
        if (round % 3 == 0) stream.unget();
    }
    return 0;
}
