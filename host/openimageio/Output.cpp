#include "host/openimageio/Output.h"

#include <OpenImageIO/filesystem.h>
#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstddef>
#include <cstdio>
#include <filesystem>
#include <iterator>
#include <string_view>
#include <system_error>
#include <vector>

#include "host/Error.h"
#include "host/openimageio/Codec.h"

namespace host::openimageio {
namespace {

namespace fs = std::filesystem;

/// By another type name than "file", so that formats write through it: libjpeg, given the file
/// itself, ends the program when the disk is full.
class FileProxy final : public OIIO::Filesystem::IOFile {
public:
    using IOFile::IOFile;
    const char* proxytype() const override { return "checked file"; }
};

constexpr char kNotWhole[] = "cannot be written whole; the disk may be full";

/// The library does not read back through a proxy, as it has to for Exif data in TIFF files; these
/// it opens by itself.
bool mayReadBack(const OIIO::ImageOutput& format, const std::vector<OIIO::ImageSpec>& parts) {
    const auto hasMetadata = [](const OIIO::ImageSpec& part) {
        return std::any_of(part.extra_attribs.begin(), part.extra_attribs.end(),
                           [](const auto& each) { return each.name().find("oiio:") != 0; });
    };
    return std::string_view(format.format_name()) == "tiff" &&
           std::any_of(parts.begin(), parts.end(), hasMetadata);
}

/// Has room made for a file whose format does not tell when there is none, which would be no error
/// but lines of black.
void reserve(const std::string& path, const std::vector<OIIO::ImageSpec>& parts) {
    OIIO::imagesize_t byteCount = 65536;  // what stands around the pixels
    for (const OIIO::ImageSpec& part : parts)
        byteCount += part.image_bytes(true);
    const int file = ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0666);
    if (file < 0) throw Error(path, std::generic_category().message(errno));
    const int error = posix_fallocate(file, 0, static_cast<off_t>(byteCount));
    ::close(file);
    if (error == ENOSPC || error == EFBIG || error == EDQUOT) throw Error(path, kNotWhole);
}

/// Formats whose files are as they were asked for where every byte has arrived. Others may write
/// what cannot be read, such as an image wider than their headers tell.
bool isDependableFormat(std::string_view format) {
    constexpr std::string_view kFormats[] = {"openexr", "tiff",  "dpx", "png", "jpeg",
                                             "hdr",     "targa", "pnm", "bmp"};
    return std::find(std::begin(kFormats), std::end(kFormats), format) != std::end(kFormats);
}

bool hasLines(OIIO::ImageInput& input) {
    const OIIO::ImageSpec& spec = input.spec();
    std::vector<std::byte> line(spec.scanline_bytes(true));
    if (spec.tile_width != 0) return true;
    for (int y = spec.y; y < spec.y + spec.height; ++y) {
        if (!input.read_scanline(y, spec.z, OIIO::TypeUnknown, line.data())) return false;
    }
    return true;
}

}  // namespace

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
        if (!file_) throw Error(path_, std::generic_category().message(errno));
        isStarted_ = true;
        proxy_ = std::make_unique<FileProxy>(file_.get(), OIIO::Filesystem::IOProxy::Write);
        return proxy_.get();
    }

    /// A format has opened the file by itself.
    void started() { isStarted_ = true; }

    /// @throws Error  bytes have not arrived, whatever the format makes of that
    void expectTaken() const {
        if (file_ && std::ferror(file_.get()) != 0) throw Error(path_, kNotWhole);
    }

    /// The format is done.
    void close() {
        proxy_.reset();
        expectTaken();
        if (file_ && std::fclose(file_.release()) != 0) throw Error(path_, kNotWhole);
    }

    /// The file is good, and stays.
    void keep() { isFinished_ = true; }

private:
    struct Close {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };
    const std::string path_;
    std::unique_ptr<std::FILE, Close> file_;
    std::unique_ptr<FileProxy> proxy_;
    bool isStarted_ = false;
    bool isFinished_ = false;
};

Output::Output(const std::string& path)
    : path_(path),
      file_(std::make_unique<OutputFile>(path)),
      format_(OIIO::ImageOutput::create(path)) {
    if (!format_) fail(path_, OIIO::geterror(), "cannot be written");
    // Two keep no image; the third is not read, see Input.
    const std::string_view format = format_->format_name();
    if (format == "term" || format == "null" || format == "ico") {
        throw Error(path_, "is of a kind that is not written");
    }
}

Output::~Output() = default;

void Output::open(const std::vector<OIIO::ImageSpec>& parts) {
    first_ = parts.front();
    partCount_ = static_cast<int>(parts.size());
    expectSize(first_);
    if (format_->supports("ioproxy") && !mayReadBack(*format_, parts)) {
        format_->set_ioproxy(file_->open());
    } else if (!format_->supports("ioproxy")) {
        file_->started();
        reserve(path_, parts);
    }
    // Some formats want to know all parts first; others have no such call.
    expectWritten(parts.size() == 1
                      ? format_->open(path_, parts.front())
                      : format_->open(path_, static_cast<int>(parts.size()), parts.data()));
    file_->started();
}

void Output::append(const OIIO::ImageSpec& part) {
    expectWritten(format_->open(path_, part, OIIO::ImageOutput::AppendSubimage));
}

void Output::expectWritten(bool isGood) const {
    if (isGood) return;
    file_->expectTaken();  // TIFF calls a full disk a bad directory
    fail(path_, format_->geterror(), "cannot be written");
}

void Output::expectSize(const OIIO::ImageSpec& spec) const {
    // The JPEG library would end the program.
    constexpr int kMostOfJPEG = 65500;
    if (format_->format_name() == std::string_view("jpeg") &&
        std::max(spec.width, spec.height) > kMostOfJPEG) {
        throw Error(path_, "a JPEG file has at most " + std::to_string(kMostOfJPEG) +
                               " pixels in a line and as many lines");
    }
}

/// The directory that ends a TIFF file may not have arrived; and see isDependableFormat.
void Output::expectReadable() const {
    if (!fs::is_regular_file(path_)) return;
    const bool isDependable = isDependableFormat(format_->format_name());
    const auto input = OIIO::ImageInput::open(path_);
    const bool isSame =
        input && input->spec().width == first_.width && input->spec().height == first_.height &&
        (isDependable || hasLines(*input)) && input->seek_subimage(partCount_ - 1, 0);
    OIIO::geterror();  // said otherwise
    if (input) input->geterror();
    if (isSame) return;
    throw Error(path_, isDependable ? kNotWhole : "its format does not hold such an image");
}

void Output::finish() {
    expectWritten(format_->close());
    file_->close();
    expectReadable();
    file_->keep();
}

}  // namespace host::openimageio
