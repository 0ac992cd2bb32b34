#pragma once

#include <OpenImageIO/imageio.h>

#include <memory>
#include <string>
#include <vector>

namespace host::openimageio {

class OutputFile;

/// An image file that is being written, in the format of its extension; removed at the end unless
/// it is finished.
class Output {
public:
    /// Finds the format; the file is not touched.
    /// @throws Error  with path and reason
    explicit Output(const std::string& path);
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;
    ~Output();

    OIIO::ImageOutput& operator*() const { return *format_; }
    OIIO::ImageOutput* operator->() const { return format_.get(); }

    /// Starts the file, with the first of its parts.
    /// @throws Error
    void open(const std::vector<OIIO::ImageSpec>& parts);

    /// Goes on to the next part.
    /// @throws Error
    void append(const OIIO::ImageSpec& part);

    /// @param isGood   what a write has returned
    /// @throws Error   if not
    void expectWritten(bool isGood) const;

    /// Closes the file behind its last pixel.
    /// @throws Error  if it could not be written whole
    void finish();

private:
    void expectSize(const OIIO::ImageSpec& spec) const;
    void expectReadable() const;

    const std::string path_;
    OIIO::ImageSpec first_;
    int partCount_ = 0;
    std::unique_ptr<OutputFile> file_;
    std::unique_ptr<OIIO::ImageOutput> format_;  // uses the file to its own end
};

}  // namespace host::openimageio
