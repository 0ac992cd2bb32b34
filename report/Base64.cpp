#include "report/Base64.h"

#include <cstdint>

namespace report {

std::string base64(const void* bytes, std::size_t byteCount) {
    constexpr char kDigits[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    const auto* const in = static_cast<const unsigned char*>(bytes);
    std::string text;
    text.reserve((byteCount + 2) / 3 * 4);
    for (std::size_t i = 0; i < byteCount; i += 3) {
        const std::size_t held = byteCount - i;
        const std::uint32_t three = std::uint32_t{in[i]} << 16U |
                                    (held > 1 ? std::uint32_t{in[i + 1]} << 8U : 0U) |
                                    (held > 2 ? std::uint32_t{in[i + 2]} : 0U);
        text += kDigits[three >> 18U];
        text += kDigits[three >> 12U & 63U];
        text += held > 1 ? kDigits[three >> 6U & 63U] : '=';
        text += held > 2 ? kDigits[three & 63U] : '=';
    }
    return text;
}

}  // namespace report
