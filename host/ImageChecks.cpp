#include "host/ImageChecks.h"

#include <fmt/format.h>

#include <cerrno>
#include <cstdint>
#include <filesystem>
#include <fstream>
#include <system_error>

#include "host/Error.h"

namespace host {
namespace {

// No compression makes that much of a byte: a file that claims more is not believed.
constexpr std::uintmax_t kMaxPixelsPerByte = 65536;

}  // namespace

void expectReadableFile(const std::string& path) {
    std::error_code failure;
    if (std::filesystem::is_directory(path, failure)) throw Error(path, "is a folder");
    errno = 0;
    if (!std::ifstream(path, std::ios::binary)) {
        throw Error(path, std::generic_category().message(errno != 0 ? errno : ENOENT));
    }
}

void expectCredibleSize(const ImageWindow& data, const std::string& path) {
    if (data.width <= 0 || data.height <= 0) throw Error(path, "has no pixels");
    const auto width = static_cast<std::uintmax_t>(data.width);
    const auto height = static_cast<std::uintmax_t>(data.height);
    std::error_code failure;
    const std::uintmax_t byteCount = std::filesystem::file_size(path, failure);
    if (!failure && width * height / kMaxPixelsPerByte > byteCount) {
        throw Error(path,
                    fmt::format("claims {} x {} pixels in {} bytes", width, height, byteCount));
    }
}

}  // namespace host
