#include "orlith/Json.h"

#include <fmt/format.h>

#include <cmath>
#include <nlohmann/json.hpp>

namespace orlith {

std::string jsonText(const std::string& text) {
    constexpr int kOneLine = -1;
    return nlohmann::json(text).dump(kOneLine, ' ', false,
                                     nlohmann::json::error_handler_t::replace);
}

std::string jsonNumber(float number) {
    if (std::isnan(number)) return "\"nan\"";
    if (std::isinf(number)) return number > 0 ? "\"inf\"" : "\"-inf\"";
    return fmt::format("{}", number);
}

std::string jsonTriple(const float* rgb) {
    return fmt::format("[{}, {}, {}]", jsonNumber(rgb[0]), jsonNumber(rgb[1]), jsonNumber(rgb[2]));
}

}  // namespace orlith
