#include <OpenImageIO/filesystem.h>
#include <OpenImageIO/imageio.h>

#include <fmt/format.h>

#include <algorithm>
#include <cstddef>
#include <fstream>
#include <iterator>
#include <new>
#include <string_view>
#include <utility>

#include "host/Error.h"
#include "host/openimageio/Bands.h"
#include "host/openimageio/Blocks.h"
#include "host/openimageio/Codec.h"
#include "host/openimageio/HeldImage.h"
#include "host/openimageio/Parts.h"
#include "host/openimageio/SampleType.h"

namespace host::openimageio {
namespace {

[[noreturn]] void failReading(const std::string& path, const std::string& reason) {
    fail(path, reason, "is damaged or cut off");
}

ImageFrame frameOf(const OIIO::ImageSpec& spec) {
    return {{spec.x, spec.y, spec.width, spec.height},
            {spec.full_x, spec.full_y, spec.full_width, spec.full_height}};
}

/// JPEG alone is decoded to a picture of any length: what is missing comes out grey. A whole file
/// has its end marker, which coded data never contain, at its end or a little before.
void expectWholeJPEG(const std::string& path) {
    constexpr std::streamoff kTailBytes = 65536;
    std::ifstream file(path, std::ios::binary | std::ios::ate);
    file.seekg(-std::min<std::streamoff>(file.tellg(), kTailBytes), std::ios::end);
    const std::string tail{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    if (tail.find("\xff\xd9") == std::string::npos) throw Error(path, "is cut off");
}

/// A file that remembers whether it ended before a read did. DPX needs it: lines of 10 and 12 bits
/// that are not there are taken to be black. Nothing is read ahead there, so that only what is
/// missing counts.
class WatchedFile final : public OIIO::Filesystem::IOFile {
public:
    explicit WatchedFile(const std::string& path) : IOFile(path, Read) {}

    const char* proxytype() const override { return "watched file"; }
    std::size_t read(void* buffer, std::size_t size) override {
        const std::size_t count = IOFile::read(buffer, size);
        wasShort_ = wasShort_ || count < size;
        return count;
    }
    bool wasShort() const { return wasShort_; }

private:
    bool wasShort_ = false;
};

class Reader final : public ImageReader {
public:
    Reader(const std::string& path, const ImageChoice& choice) : path_(path) {
        OIIO::ImageSpec wishes;
        wishes["oiio:UnassociatedAlpha"] = 1;  // colours as the file has them
        input_ = OIIO::ImageInput::open(path_, &wishes);
        if (!input_) failReading(path_, OIIO::geterror());
        if (formatName() == "dpx") reopenWatched(wishes);
        chosen_ = chooseImage(*input_, choice, path_);
        frame_ = frameOf(chosen_.spec);
    }

    const ImageFrame& frame() const override { return frame_; }
    const std::string& remark() const override { return chosen_.remark; }
    std::string sampleType() const override { return sampleTypeOf(chosen_.spec); }

    const float* line(int line) override {
        try {
            if (!lines_) lines_ = openLines();
            return lines_->line(line);
        } catch (const std::bad_alloc&) {
            const OIIO::ImageSpec& spec = chosen_.spec;
            throw Error(path_, fmt::format("{} x {} pixels do not fit into memory", spec.width,
                                           spec.height));
        }
    }

private:
    std::string_view formatName() const { return input_->format_name(); }

    void reopenWatched(const OIIO::ImageSpec& wishes) {
        input_->close();
        file_ = std::make_unique<WatchedFile>(path_);
        OIIO::ImageSpec ignored;
        if (!input_->set_ioproxy(file_.get()) || !input_->open(path_, ignored, wishes)) {
            failReading(path_, input_->geterror());
        }
    }

    std::unique_ptr<Lines> openLines() {
        const OIIO::ImageSpec& spec = chosen_.spec;
        const int blockLines = blockLinesOf(spec, formatName());
        if (blockLines > 0) {
            return std::make_unique<Bands>(
                spec.width, spec.height, blockLines,
                [this](int first, int end, float* rgb) { readLines(first, end, rgb); });
        }
        if (formatName() == "jpeg") expectWholeJPEG(path_);
        return std::make_unique<HeldImage>(spec.width, spec.height, spec.format,
                                           [this](void* rgb) { readImage(rgb); });
    }

    void readLines(int first, int end, float* rgb) {
        const OIIO::ImageSpec& spec = chosen_.spec;
        const int top = spec.y + first;
        const int bottom = spec.y + end;
        readChannels(OIIO::TypeFloat, rgb, [&](int channel, int channelEnd, void* target) {
            constexpr OIIO::stride_t kPixelBytes = 3 * sizeof(float);
            if (spec.tile_width == 0) {
                return input_->read_scanlines(chosen_.part, 0, top, bottom, spec.z, channel,
                                              channelEnd, OIIO::TypeFloat, target, kPixelBytes);
            }
            return input_->read_tiles(chosen_.part, 0, spec.x, spec.x + spec.width, top, bottom,
                                      spec.z, spec.z + 1, channel, channelEnd, OIIO::TypeFloat,
                                      target, kPixelBytes);
        });
    }

    void readImage(void* rgb) {
        const OIIO::TypeDesc type = chosen_.spec.format;
        readChannels(type, rgb, [&](int channel, int channelEnd, void* target) {
            return input_->read_image(chosen_.part, 0, channel, channelEnd, type, target,
                                      static_cast<OIIO::stride_t>(3 * type.size()));
        });
        input_.reset();  // formats keep what they have decoded
    }

    /// Has channels read so that triples of red, green and blue come out.
    /// @param read  reads channels first to end - 1 to where the first pixel's are
    template <typename Read>
    void readChannels(OIIO::TypeDesc type, void* rgb, const Read& read) {
        const auto [red, green, blue] = chosen_.channels;
        const bool isTogether = green == red + 1 && blue == red + 2;
        for (std::size_t i = 0; i < chosen_.channels.size(); i += isTogether ? 3 : 1) {
            const int channel = chosen_.channels[i];
            auto* const target = static_cast<std::byte*>(rgb) + i * type.size();
            if (!read(channel, channel + (isTogether ? 3 : 1), target) ||
                input_->has_error()) {  // TIFF: strips that are not there, and still a good result
                failReading(path_, input_->geterror());
            }
        }
        if (file_ && file_->wasShort()) throw Error(path_, "is cut off");
    }

    const std::string path_;
    std::unique_ptr<WatchedFile> file_;  // where the library has to be watched
    std::unique_ptr<OIIO::ImageInput> input_;
    ChosenImage chosen_;
    ImageFrame frame_;
    std::unique_ptr<Lines> lines_;  // from the first line asked for
};

}  // namespace

std::unique_ptr<ImageReader> openImage(const std::string& path, const ImageChoice& choice) {
    return std::make_unique<Reader>(path, choice);
}

}  // namespace host::openimageio
