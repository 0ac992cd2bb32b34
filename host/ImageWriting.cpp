#include <OpenImageIO/imageio.h>
#include <fmt/format.h>

#include <cstddef>
#include <filesystem>
#include <memory>
#include <system_error>
#include <vector>

#include "host/Cancel.h"
#include "host/Error.h"
#include "host/ImageFile.h"
#include "host/ImageLines.h"
#include "host/Text.h"

namespace host {
namespace {

namespace fs = std::filesystem;

[[noreturn]] void fail(const std::string& path, const std::string& reason) {
    throw Error(fmt::format("{}: {}", path, oneLine(reason)));
}

/// Removes what a failed writing leaves behind, but neither a file that was there before and could
/// not be opened, nor a device.
class UnfinishedFile {
public:
    explicit UnfinishedFile(std::string path) : path_(std::move(path)) {
        std::error_code ignored;
        isOurs_ = !fs::exists(path_, ignored);
    }
    UnfinishedFile(const UnfinishedFile&) = delete;
    UnfinishedFile& operator=(const UnfinishedFile&) = delete;
    ~UnfinishedFile() {
        std::error_code ignored;
        if (isOurs_ && !isFinished_ && fs::is_regular_file(path_, ignored)) {
            fs::remove(path_, ignored);
        }
    }

    void opened() { isOurs_ = true; }
    void finished() { isFinished_ = true; }

private:
    std::string path_;
    bool isOurs_;
    bool isFinished_ = false;
};

OIIO::ImageSpec specOf(const zefra::Box& box, const std::string& formatName) {
    const bool holdsFloat = formatName == "openexr" || formatName == "tiff";
    OIIO::ImageSpec spec(box.width(), box.height(), 3,
                         holdsFloat ? OIIO::TypeFloat : OIIO::TypeUInt16);
    // A display window from the origin to the top right corner, so that the box is read back as it
    // is where the format has windows.
    spec.x = box.x;
    spec.full_width = box.r;
    spec.full_height = box.t;
    return spec;
}

/// The row as r g b triples.
void interleave(const zefra::Row& row, std::vector<float>& pixels) {
    const float* const red = row.pixels(zefra::kRed);
    const float* const green = row.pixels(zefra::kGreen);
    const float* const blue = row.pixels(zefra::kBlue);
    for (std::size_t i = 0; i < pixels.size() / 3; ++i) {
        pixels[3 * i] = red[i];
        pixels[3 * i + 1] = green[i];
        pixels[3 * i + 2] = blue[i];
    }
}

}  // namespace

void writeImage(const std::string& path, zefra::Iop& image) {
    image.validate(true);
    const zefra::Box box = image.box();
    if (box.width() <= 0 || box.height() <= 0) fail(path, "there are no pixels to write");
    image.request(box.x, box.y, box.r, box.t, zefra::kRGB, 0);

    const auto output = OIIO::ImageOutput::create(path);
    if (!output) fail(path, OIIO::geterror());
    UnfinishedFile file(path);
    if (!output->open(path, specOf(box, output->format_name()))) fail(path, output->geterror());
    file.opened();

    zefra::Row row(box.x, box.r);
    std::vector<float> pixels(static_cast<std::size_t>(box.width()) * 3);
    for (int line = 0; line < box.height(); ++line) {
        if (cancelRequested()) fail(path, "cancelled");
        row.get(image, rowOfLine(box, line), box.x, box.r, zefra::kRGB);
        interleave(row, pixels);
        if (!output->write_scanline(line, 0, OIIO::TypeFloat, pixels.data())) {
            fail(path, output->geterror());
        }
    }
    if (!output->close()) fail(path, output->geterror());
    file.finished();
}

}  // namespace host
