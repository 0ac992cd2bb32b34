#include <OpenImageIO/imageio.h>
#include <OpenImageIO/parallel.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <exception>
#include <mutex>
#include <vector>

#include "host/openimageio/Codec.h"
#include "host/openimageio/CopyPlan.h"
#include "host/openimageio/Input.h"
#include "host/openimageio/Output.h"
#include "host/openimageio/PixelCopy.h"

namespace host::openimageio {
namespace {

/// Lines of a band: a power of two times the height of a tile, up to the largest block of lines
/// that a format packs together (256), within a limit of memory.
int bandLinesOf(const OIIO::ImageSpec& spec, std::size_t pixelBytes) {
    constexpr std::size_t kBandBytes = std::size_t{32} << 20;
    constexpr int kMostLines = 256;
    const int least = std::max(spec.tile_height, 1);
    const std::size_t lineBytes = pixelBytes * static_cast<std::size_t>(spec.width);
    int lines = kMostLines;
    while (lines > 1 && static_cast<std::size_t>(lines) * lineBytes > kBandBytes)
        lines /= 2;
    return std::max(lines / least, 1) * least;
}

/// Has ranges of pixels done by all threads.
/// @throws  what the work throws
template <typename Work>
void forEachRange(std::size_t pixelCount, const Work& work) {
    constexpr std::int64_t kRangePixels = 16384;
    std::mutex mutex;
    std::exception_ptr failure;  // the library's threads would keep it to themselves
    OIIO::parallel_for_chunked(0, static_cast<std::int64_t>(pixelCount), kRangePixels,
                               [&](std::int64_t begin, std::int64_t end) {
                                   try {
                                       work(static_cast<std::size_t>(begin),
                                            static_cast<std::size_t>(end - begin));
                                   } catch (...) {
                                       const std::lock_guard lock(mutex);
                                       failure = std::current_exception();
                                   }
                               });
    if (failure) std::rethrow_exception(failure);
}

class Copier {
public:
    explicit Copier(const ImageCopy& copy)
        : copy_(copy),
          input_(copy.from),
          output_(copy.to),
          target_(*output_, copy.to, copy.sampleType),
          plan_(planCopy(*input_, copy, target_)) {
        for (const PlannedImage& each : plan_.images)
            lineCount_ += each.from.height;
    }

    CopiedImage run() {
        std::vector<OIIO::ImageSpec> parts;
        for (const PlannedImage& each : plan_.images)
            parts.push_back(each.to);
        output_.open(parts);
        for (const PlannedImage& each : plan_.images) {
            if (&each != &plan_.images.front()) output_.append(each.to);
            copyImage(each);
        }
        output_.finish();
        return report();
    }

private:
    void copyImage(const PlannedImage& image) {
        const PixelCopy copyPixels(image, copy_);
        const auto width = static_cast<std::size_t>(image.from.width);
        const int bandLines = std::min(
            bandLinesOf(image.from,
                        std::max(copyPixels.readPixelBytes(), copyPixels.writtenPixelBytes())),
            image.from.height);
        const std::size_t bandPixels = width * static_cast<std::size_t>(bandLines);
        std::vector<std::byte> in(bandPixels * copyPixels.readPixelBytes());
        std::vector<std::byte> out(
            copyPixels.isInPlace() ? 0 : bandPixels * copyPixels.writtenPixelBytes());
        std::byte* const written = copyPixels.isInPlace() ? in.data() : out.data();

        for (int line = 0; line < image.from.height; line += bandLines) {
            const int end = std::min(line + bandLines, image.from.height);
            read(image, line, end, in.data());
            forEachRange(width * static_cast<std::size_t>(end - line),
                         [&](std::size_t first, std::size_t count) {
                             copyPixels(in.data() + first * copyPixels.readPixelBytes(),
                                        written + first * copyPixels.writtenPixelBytes(), count);
                         });
            write(image.to, line, end, written);
            linesDone_ += end - line;
            copy_.progress(static_cast<double>(linesDone_) / static_cast<double>(lineCount_));
        }
    }

    /// Lines of the data window, counted from 0.
    void read(const PlannedImage& image, int line, int end, std::byte* pixels) const {
        const OIIO::ImageSpec& spec = image.from;
        const int top = spec.y + line;
        const int bottom = spec.y + end;
        input_.expectRead(spec.tile_width == 0
                              ? input_->read_scanlines(image.part, 0, top, bottom, spec.z, 0,
                                                       spec.nchannels, OIIO::TypeUnknown, pixels)
                              : input_->read_tiles(image.part, 0, spec.x, spec.x + spec.width, top,
                                                   bottom, spec.z, spec.z + 1, 0, spec.nchannels,
                                                   OIIO::TypeUnknown, pixels));
        input_.expectWhole();
    }

    void write(const OIIO::ImageSpec& spec, int line, int end, const std::byte* pixels) const {
        const int top = spec.y + line;
        const int bottom = spec.y + end;
        // By its name where it has one: formats that convert what they are given, or fill tiles at
        // the edges, do not know what "as it is" means.
        const OIIO::TypeDesc type = spec.channelformats.empty() ? spec.format : OIIO::TypeUnknown;
        output_.expectWritten(spec.tile_width == 0
                                  ? output_->write_scanlines(top, bottom, spec.z, type, pixels)
                                  : output_->write_tiles(spec.x, spec.x + spec.width, top, bottom,
                                                         spec.z, spec.z + 1, type, pixels));
    }

    CopiedImage report() const {
        const auto changed =
            std::find_if(plan_.images.begin(), plan_.images.end(),
                         [](const PlannedImage& image) { return image.isChanged; });
        CopiedImage copied;
        copied.width = changed->to.width;
        copied.height = changed->to.height;
        copied.sampleType = nameOf(sampleTypeOf(changed->to, changed->rgbTo[0]));
        copied.isPremultiplied = changed->isPremultiplied;
        copied.remark = plan_.remark;
        copied.losses = target_.losses();
        return copied;
    }

    const ImageCopy& copy_;
    const Input input_;
    Output output_;
    CopyTarget target_;
    const CopyPlan plan_;
    std::int64_t lineCount_ = 0;  // of all images
    std::int64_t linesDone_ = 0;
};

}  // namespace

CopiedImage copyImage(const ImageCopy& copy) {
    if (copy.threadCount > 0) {
        OIIO::attribute("threads", copy.threadCount);
        OIIO::attribute("exr_threads", copy.threadCount);
    }
    return Copier(copy).run();
}

}  // namespace host::openimageio
