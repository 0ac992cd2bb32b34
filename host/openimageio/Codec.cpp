#include "host/openimageio/Codec.h"

#include "host/Error.h"
#include "host/ImageChecks.h"
#include "host/Text.h"

namespace host::openimageio {
namespace {

class Codec final : public ImageCodec {
public:
    std::unique_ptr<ImageReader> open(const std::string& path,
                                      const ImageChoice& choice) const override {
        return openImage(path, choice);
    }
    std::unique_ptr<ImageWriter> create(const std::string& path, const ImageFrame& frame,
                                        const std::string& sampleType) const override {
        return createImage(path, frame, sampleType);
    }
    CopiedImage copy(const ImageCopy& copy) const override {
        expectReadableFile(copy.from);
        return copyImage(copy);
    }
};

}  // namespace

void fail(const std::string& path, const std::string& reason, const char* unexplained) {
    const std::string line = firstLine(reason);
    throw Error(path, line.empty() ? unexplained : line);
}

}  // namespace host::openimageio

const host::ImageCodec* orlithImageCodec() {
    static const host::openimageio::Codec codec;
    return &codec;
}
