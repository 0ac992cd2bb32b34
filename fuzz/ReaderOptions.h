#pragma once

#include <cstdint>

#include "lut/io/LUTFileReader.h"
#include "lut/property/PropertySet.h"

namespace fuzz {

/// How files are read and written.
enum class Mode { Book, Meant };

inline Mode modeOf(int chance) {
    return chance % 2 == 0 ? Mode::Book : Mode::Meant;
}

inline auto interchange(Mode mode) {
    namespace property = Orlith::Property;
    return property::makeProperty<property::Int>("interchange", mode == Mode::Meant ? 1 : 0);
}

/// Gives a reader its mode and the options of .3dl files, chosen by two bytes; other readers have
/// no use for them.
inline void setReaderOptions(Orlith::LUT::LUTFileReader& reader, std::uint8_t dialect,
                             std::uint8_t depth, Mode mode) {
    namespace property = Orlith::Property;
    constexpr const char* kDialects[] = {"auto", "flame", "lustre", "scratch"};
    constexpr int kDepths[] = {-2, -1, 10, 16, 31, 0, 4096, -2};
    const auto set = [&](const char* name, auto value) { reader.setProperty(name, value); };
    set("interchange", interchange(mode));
    set("format3DL", property::makeProperty<property::String>("format3DL", kDialects[dialect % 4]));
    set("outputBitDepth",
        property::makeProperty<property::Int>("outputBitDepth", kDepths[depth % 8]));
    set("normalizeOutput", property::makeProperty<property::Int>("normalizeOutput", depth / 8 % 2));
}

}  // namespace fuzz
