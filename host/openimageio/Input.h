#pragma once

#include <OpenImageIO/imageio.h>

#include <memory>
#include <string>
#include <string_view>

namespace host::openimageio {

class WatchedFile;

/// An image file that is being read, with an eye on what the library takes for good although it is
/// not there. Colours stay as the file has them: they are not multiplied by alpha.
class Input {
public:
    /// @throws Error  with path and reason; also of a JPEG file that ends too early
    explicit Input(const std::string& path);
    Input(const Input&) = delete;
    Input& operator=(const Input&) = delete;
    ~Input();

    OIIO::ImageInput& operator*() const { return *image_; }
    OIIO::ImageInput* operator->() const { return image_.get(); }
    std::string_view formatName() const { return image_->format_name(); }

    /// @param isGood   what a read has returned
    /// @throws Error   if it or the library's notes say otherwise
    void expectRead(bool isGood) const;

    /// To be called when pixels were read.
    /// @throws Error  some of them were not there
    void expectWhole() const;

private:
    const std::string path_;
    std::unique_ptr<WatchedFile> file_;  // where the library has to be watched
    std::unique_ptr<OIIO::ImageInput> image_;
};

}  // namespace host::openimageio
