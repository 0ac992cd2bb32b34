#include "host/openimageio/SampleType.h"

#include <OpenImageIO/filesystem.h>
#include <fmt/format.h>

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string_view>
#include <system_error>
#include <vector>

#include "host/Error.h"
#include "host/ImageCodec.h"

namespace host::openimageio {
namespace {

namespace fs = std::filesystem;

constexpr char kBits[] = "oiio:BitsPerSample";  // where they are fewer than the type has

struct SampleType {
    std::string_view name;
    OIIO::TypeDesc type;
    int bits;
};

const SampleType kTypes[] = {
    {"uint8", OIIO::TypeUInt8, 8},    {"uint10", OIIO::TypeUInt16, 10},
    {"uint12", OIIO::TypeUInt16, 12}, {"uint16", OIIO::TypeUInt16, 16},
    {"half", OIIO::TypeHalf, 16},     {"float", OIIO::TypeFloat, 32},
};
static_assert(std::size(kTypes) == std::size(kSampleTypes));

bool isOfType(const OIIO::ImageSpec& spec, const SampleType& type) {
    const int typeBits = static_cast<int>(8 * spec.format.size());
    return spec.format == type.type && spec.get_int_attribute(kBits, typeBits) == type.bits;
}

/// A path in the system's folder for such files that nothing has yet, removed at the end.
class TemporaryPath {
public:
    explicit TemporaryPath(const fs::path& extension)
        : path_(fs::temp_directory_path() /
                (OIIO::Filesystem::unique_path("orlith-%%%%%%%%%%%%") + extension.string())) {}
    TemporaryPath(const TemporaryPath&) = delete;
    TemporaryPath& operator=(const TemporaryPath&) = delete;
    ~TemporaryPath() {
        std::error_code ignored;
        fs::remove(path_, ignored);
    }
    std::string string() const { return path_.string(); }

private:
    fs::path path_;
};

/// Makes sure that the types can be tried: else what the system refuses looks like a type that a
/// format does not hold.
void expectTemporaryFolder(const std::string& path) {
    constexpr std::size_t kByteCount = 65536;  // more than any of the small files
    fs::path folder;
    std::error_code failure;
    try {
        folder = fs::temp_directory_path();
        const TemporaryPath probe("");
        errno = 0;
        std::ofstream file(probe.string(), std::ios::binary);
        file << std::string(kByteCount, '\0');
        file.close();
        if (!file) failure = {errno != 0 ? errno : EIO, std::generic_category()};
    } catch (const fs::filesystem_error& error) {
        folder = "TMPDIR";  // which names none
        failure = error.code();
    }
    if (failure) {
        throw Error(path, fmt::format("sample types are tried in the temporary folder {}: {}",
                                      folder.string(), failure.message()));
    }
}

/// Whether a file of that extension, asked for a type, has it.
bool formatHolds(const fs::path& extension, const SampleType& type) {
    constexpr int kSide = 16;  // no format is too coarse for it
    const TemporaryPath path(extension);
    OIIO::ImageSpec spec(kSide, kSide, 3);
    setSampleType(spec, std::string(type.name));
    const std::vector<float> pixels(std::size_t{3} * kSide * kSide);
    const auto output = OIIO::ImageOutput::create(path.string());
    if (!output || !output->open(path.string(), spec) ||
        !output->write_image(OIIO::TypeFloat, pixels.data()) || !output->close()) {
        return false;
    }
    const auto input = OIIO::ImageInput::open(path.string());
    OIIO::geterror();  // of a format that does not read what it has written: said below
    return input && isOfType(input->spec(), type);
}

}  // namespace

void setSampleType(OIIO::ImageSpec& spec, const std::string& type) {
    for (const SampleType& each : kTypes) {
        if (each.name != type) continue;
        spec.set_format(each.type);
        spec.attribute(kBits, each.bits);
    }
}

std::string sampleTypeOf(const OIIO::ImageSpec& spec) {
    for (const SampleType& each : kTypes) {
        if (isOfType(spec, each)) return std::string(each.name);
    }
    return "";
}

int codeMaxOf(const std::string& type) {
    for (const SampleType& each : kTypes) {
        const bool isPartOfInteger =
            each.type == OIIO::TypeUInt16 && each.bits < static_cast<int>(8 * each.type.size());
        if (each.name == type && isPartOfInteger) return (1 << each.bits) - 1;
    }
    return 0;
}

void expectFormatHolds(const std::string& path, const std::string& type) {
    const fs::path extension = fs::path(path).extension();
    expectTemporaryFolder(path);
    std::vector<std::string_view> held;
    for (const SampleType& each : kTypes) {
        if (formatHolds(extension, each)) held.push_back(each.name);
        if (!held.empty() && held.back() == type) return;
    }
    if (held.empty()) throw Error(path, extension.string() + " files leave no choice of types");
    throw Error(path, fmt::format("{} files hold {}, not {}", extension.string(),
                                  fmt::join(held, ", "), type));
}

}  // namespace host::openimageio
