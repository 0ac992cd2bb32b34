#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "zefra/Export.h"

// What the host needs of a library for image files. That library brings hundreds of others with it,
// so it is in a module of its own, which is loaded when the first image is opened or written.

namespace host {

/// A rectangle of pixels: its top left one and its size. Lines are counted downward.
struct ImageWindow {
    int x = 0;
    int y = 0;
    int width = 0;
    int height = 0;
};

/// Where an image is.
struct ImageFrame {
    ImageWindow data;     ///< the pixels that the file has
    ImageWindow display;  ///< the picture that they are part of; empty if the file does not say
};

/// Types of samples by name: integers of so many bits, which stand for 0 to 1, and floats.
inline constexpr const char* kSampleTypes[] = {"uint8",  "uint10", "uint12",
                                               "uint16", "half",   "float"};

/// Which image of a file that holds several.
struct ImageChoice {
    int part = -1;      ///< of images behind one another, counted from 0; -1: the first in colour
    std::string layer;  ///< of channels such as "diffuse.R", "diffuse.G", "diffuse.B": "diffuse";
                        ///< empty: R, G, B without a name before them, or else the first layer
};

/// An open image file with at least three channels. Nothing else that it claims has been checked.
class ImageReader {
public:
    virtual ~ImageReader() = default;

    virtual const ImageFrame& frame() const = 0;

    /// What was taken where it was not clear, such as: holds 3 parts: took part 0 "rgba"; or empty.
    virtual const std::string& remark() const = 0;

    /// Type of the samples: one of kSampleTypes, or named in the same manner: "double", "uint14".
    virtual std::string sampleType() const = 0;

    /// A line of the data window, counted downward from 0: triples red, green, blue, which stand
    /// until the next call. Lines may be asked for in any order; going through them from either end
    /// decodes each part of the file once.
    /// @throws Error  what is asked for cannot be read, or the file is cut off
    virtual const float* line(int line) = 0;
};

/// An image file that is being written; removed at the end unless it is finished.
class ImageWriter {
public:
    virtual ~ImageWriter() = default;

    /// Writes the next line of the data window, triples red, green, blue.
    /// @throws Error
    virtual void writeLine(const float* rgb) = 0;

    /// Closes the file after its last line.
    /// @throws Error  if it could not be written whole
    virtual void finish() = 0;
};

/// A file that becomes another one with other colours and everything else as it is: the other
/// channels, parts and layers, windows, tiles, metadata, and the types of samples. What is about
/// the old colours goes: thumbnails, checksums.
struct ImageCopy {
    /// Changes so many colours in place: triples red, green, blue, as the file has them; integers
    /// stand for 0 to 1. Called from many threads at once.
    using Change = std::function<void(float* rgb, std::size_t colourCount)>;

    std::string from;
    std::string to;          ///< another file; its extension names the format
    ImageChoice choice;      ///< whose colours change
    std::string sampleType;  ///< one of kSampleTypes; empty: as it is, or the nearest held
    /// Divides colours by alpha before they change, and multiplies them behind it, where the file
    /// has them multiplied and alpha is not 0.
    bool unpremultiplies = false;
    int threadCount = 0;  ///< 0: as many as there are processors
    Change change;
    /// Told again and again how much is done, up to 1. What it throws ends the copy.
    std::function<void(double done)> progress;
};

/// What was copied, and what of it was not.
struct CopiedImage {
    int width = 0;  // of the part whose colours have changed
    int height = 0;
    std::string sampleType;           ///< of its colours
    bool isPremultiplied = false;     ///< they were multiplied by an alpha
    std::string remark;               ///< as ImageReader::remark
    std::vector<std::string> losses;  ///< what the target's format does not hold, in a line each,
                                      ///< such as: holds no channel Z; left out
};

class ImageCodec {
public:
    virtual ~ImageCodec() = default;

    /// Reads what a file says about itself.
    /// @throws Error  with path and reason; no such part or layer, and those that there are
    virtual std::unique_ptr<ImageReader> open(const std::string& path,
                                              const ImageChoice& choice) const = 0;

    /// Starts a file in the format of its extension.
    /// @param sampleType  one of kSampleTypes; empty: float where the format holds it, otherwise
    ///                    16-bit integers, or the most that the format has
    /// @throws Error      with path and reason; a type that the format does not hold
    virtual std::unique_ptr<ImageWriter> create(const std::string& path, const ImageFrame& frame,
                                                const std::string& sampleType) const = 0;

    /// Copies an image in bands of lines. The target is removed unless it is whole.
    /// @throws Error  with path and reason; also what the source is, such as deep, or lacks
    virtual CopiedImage copy(const ImageCopy& copy) const = 0;
};

/// The codec that goes with the running program. The first call loads it, and it stays loaded.
/// @throws Error  with the loader's reason
const ImageCodec& imageCodec();

}  // namespace host

/// What the module exports; never null.
extern "C" ZEFRA_EXPORT const host::ImageCodec* orlithImageCodec();
