#include "host/openimageio/PixelCopy.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

namespace host::openimageio {
namespace {

constexpr std::size_t kRunPixels = 1024;  // at a time: they stay in the nearest caches

template <std::size_t Bytes>
void copyStrided(const std::byte* from, std::size_t fromStride, std::byte* to, std::size_t toStride,
                 std::size_t count) {
    for (; count > 0; --count, from += fromStride, to += toStride)
        std::memcpy(to, from, Bytes);
}

/// Copies samples that lie so many bytes from one another.
void copySamples(std::size_t sampleBytes, const std::byte* from, std::size_t fromStride,
                 std::byte* to, std::size_t toStride, std::size_t count) {
    switch (sampleBytes) {
        case 1:
            return copyStrided<1>(from, fromStride, to, toStride, count);
        case 2:
            return copyStrided<2>(from, fromStride, to, toStride, count);
        case 4:
            return copyStrided<4>(from, fromStride, to, toStride, count);
        default:
            return copyStrided<8>(from, fromStride, to, toStride, count);
    }
}

}  // namespace

PixelCopy::Layout::Layout(const OIIO::ImageSpec& spec) {
    for (int channel = 0; channel < spec.nchannels; ++channel) {
        channels.push_back({sampleTypeOf(spec, channel), pixelBytes});
        pixelBytes += spec.channelformat(channel).size();
    }
}

PixelCopy::PixelCopy(const PlannedImage& image, const ImageCopy& copy)
    : from_(image.from),
      to_(image.to),
      channels_(image.channels),
      isChanged_(image.isChanged),
      rgb_(image.rgb),
      rgbTo_(image.rgbTo),
      alpha_(image.alpha),
      isDivided_(image.isPremultiplied && copy.unpremultiplies),
      isMultiplied_(isDivided_ || image.isAssociated),
      change_(copy.change),
      isInPlace_(from_.channels.size() == to_.channels.size() &&
                 std::is_sorted(channels_.begin(), channels_.end()) &&
                 std::equal(from_.channels.begin(), from_.channels.end(), to_.channels.begin(),
                            [](const Channel& a, const Channel& b) { return a.type == b.type; })) {}

void PixelCopy::operator()(const std::byte* from, std::byte* to, std::size_t pixelCount) const {
    while (pixelCount > 0) {
        const std::size_t run = std::min(pixelCount, kRunPixels);
        if (!isInPlace_) copyOthers(from, to, run);
        if (isChanged_) changeColours(from, to, run);
        from += run * from_.pixelBytes;
        to += run * to_.pixelBytes;
        pixelCount -= run;
    }
}

void PixelCopy::copyOthers(const std::byte* from, std::byte* to, std::size_t pixelCount) const {
    std::array<float, kRunPixels> plane;
    for (std::size_t i = 0; i < to_.channels.size(); ++i) {
        const Channel& in = from_.channels[static_cast<std::size_t>(channels_[i])];
        const Channel& out = to_.channels[i];
        if (in.type == out.type) {
            copySamples(in.type.type.size(), from + in.offset, from_.pixelBytes, to + out.offset,
                        to_.pixelBytes, pixelCount);
        } else {
            readPlane(in, from, plane.data(), pixelCount);
            writePlane(out, plane.data(), to, pixelCount);
        }
    }
}

void PixelCopy::changeColours(const std::byte* from, std::byte* to, std::size_t pixelCount) const {
    std::array<float, 3 * kRunPixels> rgb;
    std::array<float, kRunPixels> plane;
    for (std::size_t c = 0; c < 3; ++c) {
        readPlane(from_.channels[static_cast<std::size_t>(rgb_[c])], from, plane.data(),
                  pixelCount);
        for (std::size_t i = 0; i < pixelCount; ++i)
            rgb[3 * i + c] = plane[i];
    }
    std::array<float, kRunPixels> alpha;
    if (isMultiplied_) {
        readPlane(from_.channels[static_cast<std::size_t>(alpha_)], from, alpha.data(), pixelCount);
    }
    if (isDivided_) {
        // Light without cover, such as a flame's, stays as it is.
        std::replace(alpha.begin(), alpha.begin() + static_cast<std::ptrdiff_t>(pixelCount), 0.0F,
                     1.0F);
        for (std::size_t i = 0; i < 3 * pixelCount; ++i)
            rgb[i] /= alpha[i / 3];
    }
    change_(rgb.data(), pixelCount);
    if (isMultiplied_) {
        for (std::size_t i = 0; i < 3 * pixelCount; ++i)
            rgb[i] *= alpha[i / 3];
    }
    for (std::size_t c = 0; c < 3; ++c) {
        for (std::size_t i = 0; i < pixelCount; ++i)
            plane[i] = rgb[3 * i + c];
        writePlane(to_.channels[static_cast<std::size_t>(rgbTo_[c])], plane.data(), to, pixelCount);
    }
}

void PixelCopy::readPlane(const Channel& channel, const std::byte* from, float* plane,
                          std::size_t pixelCount) const {
    std::array<std::uint64_t, kRunPixels> samples;  // of up to eight bytes
    const std::size_t sampleBytes = channel.type.type.size();
    copySamples(sampleBytes, from + channel.offset, from_.pixelBytes,
                reinterpret_cast<std::byte*>(samples.data()), sampleBytes, pixelCount);
    OIIO::convert_pixel_values(channel.type.type, samples.data(), OIIO::TypeFloat, plane,
                               static_cast<int>(pixelCount));
}

void PixelCopy::writePlane(const Channel& channel, float* plane, std::byte* to,
                           std::size_t pixelCount) const {
    std::array<std::uint64_t, kRunPixels> samples;
    const std::size_t sampleBytes = channel.type.type.size();
    if (const int codeMax = codeMaxOf(channel.type); codeMax > 0) {
        roundToCodes(plane, pixelCount, codeMax);
    }
    OIIO::convert_pixel_values(OIIO::TypeFloat, plane, channel.type.type, samples.data(),
                               static_cast<int>(pixelCount));
    copySamples(sampleBytes, reinterpret_cast<const std::byte*>(samples.data()), sampleBytes,
                to + channel.offset, to_.pixelBytes, pixelCount);
}

}  // namespace host::openimageio
