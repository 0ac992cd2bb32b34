#include <OpenImageIO/imageio.h>

#include <vector>

#include "host/openimageio/Codec.h"
#include "host/openimageio/Output.h"
#include "host/openimageio/SampleType.h"

namespace host::openimageio {
namespace {

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
    if (!sampleType.empty()) setSampleType(spec, namedSampleType(sampleType));
    return spec;
}

class Writer final : public ImageWriter {
public:
    Writer(const std::string& path, const ImageFrame& frame, const std::string& sampleType)
        : line_(frame.data.y),
          sampleCount_(std::size_t{3} * static_cast<std::size_t>(frame.data.width)),
          codeMax_(sampleType.empty() ? 0 : codeMaxOf(namedSampleType(sampleType))),
          output_(path) {
        if (!sampleType.empty()) expectFormatHolds(path, namedSampleType(sampleType));
        output_.open({specOf(frame, output_->format_name(), sampleType)});
    }

    void writeLine(const float* rgb) override {
        const float* samples = rgb;
        if (codeMax_ > 0) {
            codes_.assign(rgb, rgb + sampleCount_);
            roundToCodes(codes_.data(), sampleCount_, codeMax_);
            samples = codes_.data();
        }
        output_.expectWritten(output_->write_scanline(line_++, 0, OIIO::TypeFloat, samples));
    }

    void finish() override { output_.finish(); }

private:
    int line_;                 // the next one
    std::size_t sampleCount_;  // in a line
    int codeMax_;              // of a type that the library would not round to
    std::vector<float> codes_;
    Output output_;
};

}  // namespace

std::unique_ptr<ImageWriter> createImage(const std::string& path, const ImageFrame& frame,
                                         const std::string& sampleType) {
    return std::make_unique<Writer>(path, frame, sampleType);
}

}  // namespace host::openimageio
