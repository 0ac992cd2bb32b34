#include <OpenImageIO/filesystem.h>
#include <OpenImageIO/imageio.h>

#include <cerrno>
#include <cmath>
#include <cstdio>
#include <filesystem>
#include <system_error>
#include <vector>

#include "host/Error.h"
#include "host/openimageio/Codec.h"
#include "host/openimageio/SampleType.h"

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
        if (file_ && std::ferror(file_.get()) != 0) failWhole();
    }

    /// The format is done.
    void finish() {
        proxy_.reset();
        expectTaken();
        if (file_ && std::fclose(file_.release()) != 0) failWhole();
        isFinished_ = true;
    }

private:
    [[noreturn]] void failWhole() const {
        throw Error(path_, "cannot be written whole; the disk may be full");
    }

    struct Close {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };
    const std::string path_;
    std::unique_ptr<std::FILE, Close> file_;
    std::unique_ptr<FileProxy> proxy_;
    bool isStarted_ = false;
    bool isFinished_ = false;
};

OIIO::ImageSpec specOf(const ImageFrame& frame, const std::string& formatName,
                       const std::string& sampleType) {
    const bool holdsFloat = formatName == "openexr" || formatName == "tiff";
    OIIO::ImageSpec spec(frame.data.width, frame.data.height, 3,
                         holdsFloat ? OIIO::TypeFloat : OIIO::TypeUInt16);
    spec.x = frame.data.x;
    spec.y = frame.data.y;
    spec.full_x = frame.display.x;
    spec.full_y = frame.display.y;
    spec.full_width = frame.display.width;
    spec.full_height = frame.display.height;
    setSampleType(spec, sampleType);
    return spec;
}

class Writer final : public ImageWriter {
public:
    Writer(const std::string& path, const ImageFrame& frame, const std::string& sampleType)
        : path_(path),
          line_(frame.data.y),
          sampleCount_(std::size_t{3} * static_cast<std::size_t>(frame.data.width)),
          codeMax_(static_cast<float>(codeMaxOf(sampleType))),
          file_(path) {
        format_ = OIIO::ImageOutput::create(path_);
        if (!format_) fail(path_, OIIO::geterror(), kUnexplained);
        if (!sampleType.empty()) expectFormatHolds(path_, sampleType);
        if (format_->supports("ioproxy")) format_->set_ioproxy(file_.open());
        if (!format_->open(path_, specOf(frame, format_->format_name(), sampleType))) failWriting();
        file_.started();
    }

    void writeLine(const float* rgb) override {
        const float* samples = rgb;
        if (codeMax_ > 0.0F) {
            codes_.assign(rgb, rgb + sampleCount_);
            for (float& each : codes_)
                each = std::round(each * codeMax_) / codeMax_;
            samples = codes_.data();
        }
        if (!format_->write_scanline(line_++, 0, OIIO::TypeFloat, samples)) failWriting();
    }

    void finish() override {
        if (!format_->close()) failWriting();
        file_.finish();
    }

private:
    static constexpr const char* kUnexplained = "cannot be written";

    /// The format's words, unless the system is to blame: TIFF calls a full disk a bad directory.
    [[noreturn]] void failWriting() const {
        file_.expectTaken();
        fail(path_, format_->geterror(), kUnexplained);
    }

    const std::string path_;
    int line_;                 // the next one
    std::size_t sampleCount_;  // in a line
    float codeMax_;            // of a type that the library would not round to
    std::vector<float> codes_;
    OutputFile file_;
    std::unique_ptr<OIIO::ImageOutput> format_;  // uses the file to its own end
};

}  // namespace

std::unique_ptr<ImageWriter> createImage(const std::string& path, const ImageFrame& frame,
                                         const std::string& sampleType) {
    return std::make_unique<Writer>(path, frame, sampleType);
}

}  // namespace host::openimageio
