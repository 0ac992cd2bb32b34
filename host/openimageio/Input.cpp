#include "host/openimageio/Input.h"

#include <OpenImageIO/filesystem.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <string_view>

#include "host/Error.h"
#include "host/openimageio/Codec.h"

namespace host::openimageio {
namespace {

[[noreturn]] void failReading(const std::string& path, const std::string& reason) {
    fail(path, reason, "is damaged or cut off");
}

/// JPEG is decoded to a picture of any length: what is missing comes out grey. PNG may lack what
/// stands behind its pixels. A whole file has its end marker, which coded data never contain, at
/// its end or a little before.
bool hasEnd(const std::string& path, std::string_view format) {
    const std::string_view marker = format == "jpeg"  ? "\xff\xd9"
                                    : format == "png" ? "IEND\xae\x42\x60\x82"
                                                      : "";
    if (marker.empty()) return true;
    constexpr std::streamoff kTailBytes = 65536;
    std::ifstream file(path, std::ios::binary | std::ios::ate);
    file.seekg(-std::min<std::streamoff>(file.tellg(), kTailBytes), std::ios::end);
    const std::string tail{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    return tail.find(marker) != std::string::npos;
}

}  // namespace

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

Input::Input(const std::string& path) : path_(path) {
    OIIO::ImageSpec wishes;
    wishes["oiio:UnassociatedAlpha"] = 1;
    image_ = OIIO::ImageInput::open(path_, &wishes);
    if (!image_) failReading(path_, OIIO::geterror());
    // The library damages memory with some of these files, such as its own.
    if (formatName() == "ico") throw Error(path_, "is of a kind that is not read");
    if (!hasEnd(path_, formatName())) throw Error(path_, "is cut off");
    if (formatName() != "dpx") return;
    image_->close();
    file_ = std::make_unique<WatchedFile>(path_);
    OIIO::ImageSpec ignored;
    if (!image_->set_ioproxy(file_.get()) || !image_->open(path_, ignored, wishes)) {
        failReading(path_, image_->geterror());
    }
}

Input::~Input() = default;

void Input::expectRead(bool isGood) const {
    // TIFF: strips that are not there, and still a good result.
    if (!isGood || image_->has_error()) failReading(path_, image_->geterror());
}

void Input::expectWhole() const {
    if (file_ && file_->wasShort()) throw Error(path_, "is cut off");
}

}  // namespace host::openimageio
