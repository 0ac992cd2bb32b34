#include <OpenImageIO/imageio.h>

#include <fmt/format.h>

#include <cstddef>
#include <memory>
#include <new>

#include "host/Error.h"
#include "host/openimageio/Bands.h"
#include "host/openimageio/Blocks.h"
#include "host/openimageio/Codec.h"
#include "host/openimageio/HeldImage.h"
#include "host/openimageio/Input.h"
#include "host/openimageio/Parts.h"
#include "host/openimageio/SampleType.h"

namespace host::openimageio {
namespace {

ImageFrame frameOf(const OIIO::ImageSpec& spec) {
    return {{spec.x, spec.y, spec.width, spec.height},
            {spec.full_x, spec.full_y, spec.full_width, spec.full_height}};
}

class Reader final : public ImageReader {
public:
    Reader(const std::string& path, const ImageChoice& choice)
        : path_(path),
          input_(std::make_unique<Input>(path)),
          chosen_(chooseImage(**input_, choice, path)),
          frame_(frameOf(chosen_.spec)) {}

    const ImageFrame& frame() const override { return frame_; }
    const std::string& remark() const override { return chosen_.remark; }
    std::string sampleType() const override {
        return nameOf(sampleTypeOf(chosen_.spec, chosen_.channels[0]));
    }

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
    OIIO::ImageInput& image() const { return **input_; }

    std::unique_ptr<Lines> openLines() {
        const OIIO::ImageSpec& spec = chosen_.spec;
        const int blockLines = blockLinesOf(spec, input_->formatName());
        if (blockLines > 0) {
            return std::make_unique<Bands>(
                spec.width, spec.height, blockLines,
                [this](int first, int end, float* rgb) { readLines(first, end, rgb); });
        }
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
                return image().read_scanlines(chosen_.part, 0, top, bottom, spec.z, channel,
                                              channelEnd, OIIO::TypeFloat, target, kPixelBytes);
            }
            return image().read_tiles(chosen_.part, 0, spec.x, spec.x + spec.width, top, bottom,
                                      spec.z, spec.z + 1, channel, channelEnd, OIIO::TypeFloat,
                                      target, kPixelBytes);
        });
    }

    void readImage(void* rgb) {
        const OIIO::TypeDesc type = chosen_.spec.format;
        readChannels(type, rgb, [&](int channel, int channelEnd, void* target) {
            return image().read_image(chosen_.part, 0, channel, channelEnd, type, target,
                                      static_cast<OIIO::stride_t>(3 * type.size()));
        });
        input_.reset();  // formats keep what they have decoded
    }

    /// Has channels read so that triples of red, green and blue come out.
    /// @param read  reads channels first to end - 1 to where the first pixel's are
    template <typename Read>
    void readChannels(const OIIO::TypeDesc& type, void* rgb, const Read& read) {
        const auto [red, green, blue] = chosen_.channels;
        const bool isTogether = green == red + 1 && blue == red + 2;
        for (std::size_t i = 0; i < chosen_.channels.size(); i += isTogether ? 3 : 1) {
            const int channel = chosen_.channels[i];
            auto* const target = static_cast<std::byte*>(rgb) + i * type.size();
            input_->expectRead(read(channel, channel + (isTogether ? 3 : 1), target));
        }
        input_->expectWhole();
    }

    const std::string path_;
    std::unique_ptr<Input> input_;  // until the image is held whole
    const ChosenImage chosen_;
    const ImageFrame frame_;
    std::unique_ptr<Lines> lines_;  // from the first line asked for
};

}  // namespace

std::unique_ptr<ImageReader> openImage(const std::string& path, const ImageChoice& choice) {
    return std::make_unique<Reader>(path, choice);
}

}  // namespace host::openimageio
