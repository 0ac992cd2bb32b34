#include "lut/io/Dialect3DL.h"

namespace Orlith::LUT {

Dialect3DL toDialect3DL(std::string_view word) {
    if (word == "auto") return Dialect3DL::Auto;
    if (word == "flame") return Dialect3DL::Flame;
    if (word == "lustre") return Dialect3DL::Lustre;
    if (word == "scratch") return Dialect3DL::Scratch;
    return Dialect3DL::Unknown;
}

std::int32_t codeMaxOf(std::int32_t bits) {
    const std::uint32_t shift = static_cast<std::uint32_t>(bits) % 32U;
    return static_cast<std::int32_t>(~(~std::uint32_t{0} << shift));
}

std::int32_t bitCountOf(std::int32_t code) {
    std::int32_t bits = 0;
    for (; code > 0; code >>= 1)
        ++bits;
    return bits;
}

}  // namespace Orlith::LUT
