#include "host/openimageio/Output.h"

#include <OpenImageIO/filesystem.h>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <filesystem>
#include <string_view>
#include <system_error>

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

/// Whether a file has so many parts: the directory that ends a TIFF file may not have arrived.
bool hasParts(const std::string& path, int count) {
    const auto input = OIIO::ImageInput::open(path);
    OIIO::geterror();  // said otherwise
    return input && input->seek_subimage(count - 1, 0);
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
    void finish() {
        proxy_.reset();
        expectTaken();
        if (file_ && std::fclose(file_.release()) != 0) throw Error(path_, kNotWhole);
        isFinished_ = true;
    }

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
}

Output::~Output() = default;

void Output::open(const std::vector<OIIO::ImageSpec>& parts) {
    partCount_ = static_cast<int>(parts.size());
    readsBack_ = mayReadBack(*format_, parts);
    if (format_->supports("ioproxy") && !readsBack_) format_->set_ioproxy(file_->open());
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

void Output::finish() {
    expectWritten(format_->close());
    if (readsBack_ && !hasParts(path_, partCount_)) throw Error(path_, kNotWhole);
    file_->finish();
}

}  // namespace host::openimageio
