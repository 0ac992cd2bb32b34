#pragma once

#include <filesystem>
#include <memory>
#include <string>

#include "host/ImageCodec.h"
#include "zefra/Image.h"
#include "zefra/Iop.h"
#include "zefra/Row.h"

namespace host {

/// An image file that is read as float red, green and blue.
///
/// Rows     counted upward: row 0 is the last line of the file's display window. Columns are those
///          of the file, so a data window that starts elsewhere gives a box that starts elsewhere.
/// Channels those of the chosen part and layer that the file names R, G and B, otherwise the first
///          three.
/// Memory   as the file allows, from the first row asked for: a few blocks of lines where any line
///          can be decoded without those before it, otherwise the image in its own sample type.
class ImageFile {
public:
    /// Reads what the file says about itself.
    /// @throws Error  with path and reason
    explicit ImageFile(std::string path, const ImageChoice& choice = {});

    const std::string& path() const { return path_; }
    const zefra::Box& box() const { return box_; }
    /// Which image was taken where that was not clear, in words; otherwise empty.
    const std::string& remark() const { return remark_; }

    /// As ImageReader::sampleType.
    const std::string& sampleType() const { return sampleType_; }

    /// Whether the file still is what was opened.
    bool isCurrent() const;

    /// Fills pixels x to r - 1 of row y; those outside the box are black.
    /// @throws Error  if they cannot be read, or the file is cut off
    void copyRow(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row);

private:
    std::string path_;
    std::filesystem::file_time_type time_;
    std::uintmax_t byteCount_ = 0;
    zefra::Box box_;
    std::string remark_;
    std::string sampleType_;
    std::unique_ptr<ImageReader> source_;
};

/// Writes an image row by row. A file that could not be written whole is removed.
/// @param sampleType  one of kSampleTypes; empty: float where the format holds it, otherwise 16-bit
///                    integers, or the most that the format has
/// @throws Error      with path and reason; whatever the image throws
void writeImage(const std::string& path, zefra::Iop& image, const std::string& sampleType = {});

}  // namespace host
