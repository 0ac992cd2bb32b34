#pragma once

#include <array>
#include <cstddef>
#include <vector>

#include "host/ImageCodec.h"
#include "host/openimageio/CopyPlan.h"

namespace host::openimageio {

/// Turns pixels as they are read into pixels as they are written: packed, each channel in its own
/// type. What does not change is copied bit for bit where its type stays.
class PixelCopy {
public:
    /// @param copy  kept by reference
    PixelCopy(const PlannedImage& image, const ImageCopy& copy);

    std::size_t readPixelBytes() const { return from_.pixelBytes; }
    std::size_t writtenPixelBytes() const { return to_.pixelBytes; }

    /// Whether pixels keep their layout, and so may be written from where they were read to.
    bool isInPlace() const { return isInPlace_; }

    /// Any number of threads may do this at once.
    /// @param to  the same pixels where isInPlace, otherwise others
    void operator()(const std::byte* from, std::byte* to, std::size_t pixelCount) const;

private:
    struct Channel {
        SampleType type;
        std::size_t offset;  // bytes from the start of the pixel
    };
    struct Layout {
        explicit Layout(const OIIO::ImageSpec& spec);
        std::vector<Channel> channels;
        std::size_t pixelBytes = 0;
    };

    void copyOthers(const std::byte* from, std::byte* to, std::size_t pixelCount) const;
    void changeColours(const std::byte* from, std::byte* to, std::size_t pixelCount) const;
    void readPlane(const Channel& channel, const std::byte* from, float* plane,
                   std::size_t pixelCount) const;
    void writePlane(const Channel& channel, float* plane, std::byte* to,
                    std::size_t pixelCount) const;

    const Layout from_;
    const Layout to_;
    const std::vector<int> channels_;  // as PlannedImage has it, like those below
    const bool isChanged_;
    const std::array<int, 3> rgb_;
    const std::array<int, 3> rgbTo_;
    const int alpha_;
    const bool isDivided_;     // by alpha, before the colours change
    const bool isMultiplied_;  // by it, behind that
    const ImageCopy::Change& change_;
    const bool isInPlace_;
};

}  // namespace host::openimageio
