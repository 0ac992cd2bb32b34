#include "host/ImageFile.h"

#include <OpenImageIO/imageio.h>
#include <OpenImageIO/strutil.h>
#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdint>
#include <fstream>
#include <iterator>
#include <limits>
#include <new>
#include <string_view>
#include <system_error>

#include "host/Error.h"
#include "host/ImageLines.h"
#include "host/Text.h"

namespace host {
namespace {

namespace fs = std::filesystem;

constexpr std::array<zefra::Channel, 3> kChannels = {zefra::kRed, zefra::kGreen, zefra::kBlue};

// No compression makes that much of a byte: a file that claims more is not believed.
constexpr std::uintmax_t kMaxPixelsPerByte = 65536;

[[noreturn]] void fail(const std::string& path, const std::string& reason) {
    const std::string line = firstLine(reason);
    throw Error(fmt::format("{}: {}", path, line.empty() ? "is damaged or cut off" : line));
}

/// Answers for the commonest mistakes in the system's words.
void expectReadableFile(const std::string& path) {
    std::error_code failure;
    if (fs::is_directory(path, failure)) fail(path, "is a folder");
    errno = 0;
    if (!std::ifstream(path, std::ios::binary)) {
        fail(path, std::generic_category().message(errno != 0 ? errno : ENOENT));
    }
}

/// The index of a channel that is called by its letter or its word, or -1.
int findChannel(const OIIO::ImageSpec& spec, const char* letter, const char* word) {
    for (std::size_t i = 0; i < spec.channelnames.size(); ++i) {
        const std::string& name = spec.channelnames[i];
        if (OIIO::Strutil::iequals(name, letter) || OIIO::Strutil::iequals(name, word)) {
            return static_cast<int>(i);
        }
    }
    return -1;
}

/// Where red, green and blue are among the file's channels.
std::array<int, 3> findChannels(const OIIO::ImageSpec& spec) {
    const std::array<int, 3> named = {findChannel(spec, "r", "red"),
                                      findChannel(spec, "g", "green"),
                                      findChannel(spec, "b", "blue")};
    const bool areNamed = named[0] >= 0 && named[1] >= 0 && named[2] >= 0;
    return areNamed ? named : std::array<int, 3>{0, 1, 2};
}

/// The file's data window, with rows counted upward from the bottom of its display window.
zefra::Box boxOf(const OIIO::ImageSpec& spec, const std::string& path) {
    const bool hasDisplayWindow = spec.full_height > 0;
    const std::int64_t bottom = hasDisplayWindow ? std::int64_t{spec.full_y} + spec.full_height
                                                 : std::int64_t{spec.y} + spec.height;
    const std::int64_t x = spec.x;
    const std::int64_t y = bottom - (std::int64_t{spec.y} + spec.height);
    const std::int64_t r = x + spec.width;
    const std::int64_t t = y + spec.height;
    constexpr std::int64_t kFarthest = std::numeric_limits<int>::max() / 2;
    if (x < -kFarthest || y < -kFarthest || r > kFarthest || t > kFarthest) {
        fail(path, "its data window is too far away");
    }
    return {static_cast<int>(x), static_cast<int>(y), static_cast<int>(r), static_cast<int>(t)};
}

void expectPlainImage(const OIIO::ImageSpec& spec, std::uintmax_t byteCount,
                      const std::string& path) {
    if (spec.nchannels < 3) {
        fail(path, fmt::format("needs red, green and blue channels, has {}",
                               std::max(spec.nchannels, 0)));
    }
    if (spec.deep || spec.depth > 1) fail(path, "is not a flat image");
    if (spec.width <= 0 || spec.height <= 0) fail(path, "has no pixels");
    const auto width = static_cast<std::uintmax_t>(spec.width);
    const auto height = static_cast<std::uintmax_t>(spec.height);
    if (width * height / kMaxPixelsPerByte > byteCount) {
        fail(path, fmt::format("claims {} x {} pixels in {} bytes", width, height, byteCount));
    }
}

/// JPEG alone is decoded to a picture of any length: what is missing comes out grey. A whole file
/// has its end marker, which coded data never contain, at its end or a little before.
void expectWholeJPEG(const std::string& path, std::uintmax_t byteCount) {
    constexpr std::uintmax_t kTailBytes = 65536;
    std::ifstream file(path, std::ios::binary);
    file.seekg(-static_cast<std::streamoff>(std::min(byteCount, kTailBytes)), std::ios::end);
    const std::string tail{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    if (tail.find("\xff\xd9") == std::string::npos) fail(path, "is cut off");
}

}  // namespace

struct ImageFile::Source {
    std::unique_ptr<OIIO::ImageInput> input;
    std::array<int, 3> channels;
};

ImageFile::ImageFile(std::string path) : path_(std::move(path)) {
    expectReadableFile(path_);
    std::error_code ignored;
    time_ = fs::last_write_time(path_, ignored);
    byteCount_ = fs::file_size(path_, ignored);

    OIIO::ImageSpec wishes;
    wishes["oiio:UnassociatedAlpha"] = 1;  // colours as the file has them
    auto input = OIIO::ImageInput::open(path_, &wishes);
    if (!input) fail(path_, OIIO::geterror());
    const OIIO::ImageSpec& spec = input->spec();
    expectPlainImage(spec, byteCount_, path_);
    box_ = boxOf(spec, path_);
    const std::array<int, 3> channels = findChannels(spec);
    source_ = std::make_unique<Source>(Source{std::move(input), channels});
}

ImageFile::~ImageFile() = default;

bool ImageFile::isCurrent() const {
    std::error_code failure;
    return fs::last_write_time(path_, failure) == time_ &&
           fs::file_size(path_, failure) == byteCount_;
}

void ImageFile::readPixels() {
    const std::unique_ptr<Source> source = std::move(source_);
    if (!source) fail(path_, "its pixels could not be read");
    const auto width = static_cast<std::size_t>(box_.width());
    const auto height = static_cast<std::size_t>(box_.height());
    std::unique_ptr<float[]> pixels;
    try {
        pixels.reset(new float[width * height * 3]);
    } catch (const std::bad_alloc&) {
        fail(path_, fmt::format("{} x {} pixels do not fit into memory", width, height));
    }

    OIIO::ImageInput& input = *source->input;
    if (std::string_view(input.format_name()) == "jpeg") expectWholeJPEG(path_, byteCount_);
    const auto read = [&](int firstChannel, int channelCount, float* target) {
        constexpr OIIO::stride_t kPixelBytes = 3 * sizeof(float);
        if (!input.read_image(0, 0, firstChannel, firstChannel + channelCount, OIIO::TypeFloat,
                              target, kPixelBytes) ||
            input.has_error()) {  // TIFF: strips that are not there, and still a good result
            fail(path_, input.geterror());
        }
    };
    const auto [red, green, blue] = source->channels;
    if (green == red + 1 && blue == red + 2) {
        read(red, 3, pixels.get());
    } else {
        read(red, 1, pixels.get());
        read(green, 1, pixels.get() + 1);
        read(blue, 1, pixels.get() + 2);
    }
    pixels_ = std::move(pixels);
}

void ImageFile::copyRow(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) {
    if (!pixels_) readPixels();
    const bool isInside = y >= box_.y && y < box_.t;
    const int first = std::clamp(box_.x, x, std::max(x, r));
    const int end = std::clamp(box_.r, first, std::max(first, r));
    const auto line = static_cast<std::size_t>(isInside ? lineOfRow(box_, y) : 0);
    const auto width = static_cast<std::size_t>(box_.width());

    for (std::size_t i = 0; i < kChannels.size(); ++i) {
        if ((channels & kChannels[i]) == 0) continue;
        float* const out = row.writable(kChannels[i]);
        const int left = row.left();
        std::fill(out + (x - left), out + (std::max(x, r) - left), 0.0F);
        if (!isInside) continue;
        const float* const in = pixels_.get() + line * width * 3 + i;
        for (int column = first; column < end; ++column)
            out[column - left] = in[static_cast<std::size_t>(column - box_.x) * 3];
    }
}

}  // namespace host
