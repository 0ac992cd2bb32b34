#include <OpenImageIO/filesystem.h>
#include <OpenImageIO/imageio.h>
#include <fmt/format.h>

#include <cerrno>
#include <cstddef>
#include <cstdio>
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
    const std::string line = firstLine(reason);
    throw Error(fmt::format("{}: {}", path, line.empty() ? "cannot be written" : line));
}

/// By another type name than "file", so that formats write through it: libjpeg, given the file
/// itself, ends the program when the disk is full.
class FileProxy final : public OIIO::Filesystem::IOFile {
public:
    using IOFile::IOFile;
    const char* proxytype() const override { return "checked file"; }
};

/// The file beneath an image format. Several formats do not look whether their bytes arrive, so the
/// file does; and it is removed if it was not written whole, unless it is a device.
class OutputFile {
public:
    explicit OutputFile(const std::string& path) : path_(path) {}
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;

    ~OutputFile() {
        proxy_.reset();
        file_.reset();
        std::error_code ignored;
        if (isStarted_ && !isFinished_ && fs::is_regular_file(path_, ignored)) {
            fs::remove(path_, ignored);
        }
    }

    /// Opens the file for a format that writes through it.
    OIIO::Filesystem::IOProxy* open() {
        file_.reset(std::fopen(path_.c_str(), "w+b"));
        if (!file_) fail(path_, std::generic_category().message(errno));
        isStarted_ = true;
        proxy_ = std::make_unique<FileProxy>(file_.get(), OIIO::Filesystem::IOProxy::Write);
        return proxy_.get();
    }

    /// A format has opened the file by itself.
    void started() { isStarted_ = true; }

    /// The format is done.
    void finish() {
        proxy_.reset();
        const bool hasFailed = file_ && std::ferror(file_.get()) != 0;
        const bool isClosed = !file_ || std::fclose(file_.release()) == 0;
        if (hasFailed || !isClosed) fail(path_, "cannot be written whole; the disk may be full");
        isFinished_ = true;
    }

private:
    struct Close {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };
    const std::string& path_;
    std::unique_ptr<std::FILE, Close> file_;
    std::unique_ptr<FileProxy> proxy_;
    bool isStarted_ = false;
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

    OutputFile file(path);  // before the format, which uses it to its end
    const auto format = OIIO::ImageOutput::create(path);
    if (!format) fail(path, OIIO::geterror());
    if (format->supports("ioproxy")) format->set_ioproxy(file.open());
    if (!format->open(path, specOf(box, format->format_name()))) fail(path, format->geterror());
    file.started();

    zefra::Row row(box.x, box.r);
    std::vector<float> pixels(static_cast<std::size_t>(box.width()) * 3);
    for (int line = 0; line < box.height(); ++line) {
        if (cancelRequested()) fail(path, "cancelled");
        row.get(image, rowOfLine(box, line), box.x, box.r, zefra::kRGB);
        interleave(row, pixels);
        if (!format->write_scanline(line, 0, OIIO::TypeFloat, pixels.data())) {
            fail(path, format->geterror());
        }
    }
    if (!format->close()) fail(path, format->geterror());
    file.finish();
}

}  // namespace host
