#pragma once

#include <cstdint>
#include <string>

#include "lut/Exception.h"
#include "lut/property/PropertySet.h"

namespace Orlith::LUT {

// The single value of an option that a format cannot do without. One of another kind or length
// counts as missing.

/// @throws Exception  the given text, which is static
inline std::int32_t requireInt(const Property::PropertySet& properties, const std::string& name,
                               const char* missing) {
    const auto property = properties.find(name);
    const auto* number = Property::asInt(property.get(), 1);
    if (number == nullptr) throw Exception(missing);
    return number->values[0];
}

/// @throws Exception  the given text, which is static
inline std::string requireString(const Property::PropertySet& properties, const std::string& name,
                                 const char* missing) {
    const auto property = properties.find(name);
    const auto* text = Property::asString(property.get(), 1);
    if (text == nullptr) throw Exception(missing);
    return text->values[0];
}

}  // namespace Orlith::LUT
