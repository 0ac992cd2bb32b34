#include "host/openimageio/SampleType.h"

#include <OpenImageIO/filesystem.h>
#include <fmt/format.h>

#include <algorithm>
#include <cassert>
#include <cerrno>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string_view>
#include <system_error>
#include <tuple>
#include <vector>

#include "host/Error.h"
#include "host/ImageCodec.h"

namespace host::openimageio {
namespace {

namespace fs = std::filesystem;

constexpr char kBits[] = "oiio:BitsPerSample";  // where they are fewer than the type has

struct NamedType {
    std::string_view name;
    SampleType type;
};

const NamedType kTypes[] = {
    {"uint8", {OIIO::TypeUInt8, 8}},    {"uint10", {OIIO::TypeUInt16, 10}},
    {"uint12", {OIIO::TypeUInt16, 12}}, {"uint16", {OIIO::TypeUInt16, 16}},
    {"half", {OIIO::TypeHalf, 16}},     {"float", {OIIO::TypeFloat, 32}},
};
static_assert(std::size(kTypes) == std::size(kSampleTypes));

int bitsOf(const OIIO::TypeDesc& type) {
    return static_cast<int>(8 * type.size());
}

/// Binary digits of the numbers from 0 to 1 that a type tells apart at their coarsest.
int precisionOf(const SampleType& type) {
    if (type.type == OIIO::TypeHalf) return 11;
    if (type.type == OIIO::TypeFloat) return 24;
    if (type.type == OIIO::TypeDesc(OIIO::TypeDesc::DOUBLE)) return 53;
    return type.bits;
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
    constexpr int kSide = 64;  // JPEG 2000 halves an image five times
    const TemporaryPath path(extension);
    OIIO::ImageSpec spec(kSide, kSide, 3);
    setSampleType(spec, type);
    const std::vector<float> pixels(std::size_t{3} * kSide * kSide);
    const auto output = OIIO::ImageOutput::create(path.string());
    if (!output || !output->open(path.string(), spec) ||
        !output->write_image(OIIO::TypeFloat, pixels.data()) || !output->close()) {
        return false;
    }
    const auto input = OIIO::ImageInput::open(path.string());
    OIIO::geterror();  // of a format that does not read what it has written: said below
    return input && sampleTypeOf(input->spec(), 0) == type;
}

[[noreturn]] void failWithoutChoice(const std::string& path) {
    throw Error(path, fs::path(path).extension().string() + " files leave no choice of types");
}

}  // namespace

SampleType namedSampleType(const std::string& name) {
    const auto* const found = std::find_if(std::begin(kTypes), std::end(kTypes),
                                           [&](const auto& each) { return each.name == name; });
    assert(found != std::end(kTypes));
    return found->type;
}

SampleType sampleTypeOf(const OIIO::ImageSpec& spec, int channel) {
    const OIIO::TypeDesc type = spec.channelformat(channel);
    const int bits = bitsOf(type);
    // The attribute is about a format that all channels share.
    return {type, spec.channelformats.empty() ? spec.get_int_attribute(kBits, bits) : bits};
}

SampleType widestType(const OIIO::ImageSpec& spec) {
    return spec.channelformats.empty() ? sampleTypeOf(spec, 0)
                                       : SampleType{spec.format, bitsOf(spec.format)};
}

std::string nameOf(const SampleType& type) {
    for (const NamedType& each : kTypes) {
        if (each.type == type) return std::string(each.name);
    }
    return type.bits < bitsOf(type.type) ? fmt::format("uint{}", type.bits) : type.type.c_str();
}

void setSampleType(OIIO::ImageSpec& spec, const SampleType& type) {
    spec.set_format(type.type);
    // Metadata that were not there are not made up.
    if (type.bits < bitsOf(type.type) || spec.find_attribute(kBits) != nullptr) {
        spec.attribute(kBits, type.bits);
    }
}

void setSampleTypes(OIIO::ImageSpec& spec, const std::vector<SampleType>& types) {
    setSampleType(spec, types.front());
    if (std::all_of(types.begin(), types.end(),
                    [&](const SampleType& each) { return each == types.front(); })) {
        return;
    }
    spec.erase_attribute(kBits);
    for (const SampleType& each : types) {
        spec.channelformats.push_back(each.type);
        spec.format = OIIO::TypeDesc::basetype_merge(spec.format, each.type);
    }
}

int codeMaxOf(const SampleType& type) {
    return type.bits < bitsOf(type.type) ? (1 << type.bits) - 1 : 0;
}

void roundToCodes(float* samples, std::size_t count, int codeMax) {
    const auto scale = static_cast<float>(codeMax);
    for (std::size_t i = 0; i < count; ++i)
        samples[i] = std::round(samples[i] * scale) / scale;
}

bool holdsAllOf(const SampleType& type, const SampleType& other) {
    if (type == other) return true;
    const bool isFloat = type.type.is_floating_point();
    const bool isBeyondUnit = other.type.is_floating_point() || other.type.is_signed();
    return (isFloat || !isBeyondUnit) && precisionOf(type) >= precisionOf(other);
}

SampleType nearestHeld(const std::string& path, const SampleType& wanted) {
    const fs::path extension = fs::path(path).extension();
    expectTemporaryFolder(path);
    if (formatHolds(extension, wanted)) return wanted;
    std::vector<SampleType> types;
    for (const NamedType& each : kTypes)
        types.push_back(each.type);
    // What loses nothing, the smallest first; then what loses least: range before precision.
    std::sort(types.begin(), types.end(), [&](const SampleType& a, const SampleType& b) {
        const auto rank = [&](const SampleType& type) {
            const bool holdsAll = holdsAllOf(type, wanted);
            const bool hasRange = type.type.is_floating_point() || !wanted.type.is_floating_point();
            const int precision = precisionOf(type);
            return std::make_tuple(!holdsAll, !hasRange, holdsAll ? precision : -precision);
        };
        return rank(a) < rank(b);
    });
    const auto found = std::find_if(types.begin(), types.end(), [&](const SampleType& each) {
        return formatHolds(extension, each);
    });
    if (found == types.end()) failWithoutChoice(path);
    return *found;
}

void expectFormatHolds(const std::string& path, const SampleType& wanted) {
    const fs::path extension = fs::path(path).extension();
    expectTemporaryFolder(path);
    std::vector<std::string_view> held;
    for (const NamedType& each : kTypes) {
        if (!formatHolds(extension, each.type)) continue;
        if (each.type == wanted) return;
        held.push_back(each.name);
    }
    if (held.empty()) failWithoutChoice(path);
    throw Error(path, fmt::format("{} files hold {}, not {}", extension.string(),
                                  fmt::join(held, ", "), nameOf(wanted)));
}

}  // namespace host::openimageio
