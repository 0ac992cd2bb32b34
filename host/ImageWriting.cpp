#include <cstddef>
#include <vector>

#include "host/Cancel.h"
#include "host/Error.h"
#include "host/ImageCodec.h"
#include "host/ImageFile.h"
#include "host/ImageLines.h"

namespace host {
namespace {

/// A display window from the origin to the top right corner, so that the box is read back as it is
/// where the format has windows.
ImageFrame frameOf(const zefra::Box& box) {
    return {{box.x, 0, box.width(), box.height()}, {0, 0, box.r, box.t}};
}

/// The row as r g b triples.
void interleave(const zefra::Row& row, std::vector<float>& pixels) {
    const float* const red = row.pixels(zefra::kRed);
    const float* const green = row.pixels(zefra::kGreen);
    const float* const blue = row.pixels(zefra::kBlue);
    for (std::size_t i = 0; i < pixels.size() / 3; ++i) {
        pixels[3 * i] = red[i];
        pixels[3 * i + 1] = green[i];
        pixels[3 * i + 2] = blue[i];
    }
}

}  // namespace

void writeImage(const std::string& path, zefra::Iop& image, const std::string& sampleType) {
    image.validate(true);
    const zefra::Box box = image.box();
    if (box.width() <= 0 || box.height() <= 0) throw Error(path, "there are no pixels to write");
    image.request(box.x, box.y, box.r, box.t, zefra::kRGB, 0);

    const auto file = imageCodec().create(path, frameOf(box), sampleType);
    zefra::Row row(box.x, box.r);
    std::vector<float> pixels(static_cast<std::size_t>(box.width()) * 3);
    for (int line = 0; line < box.height(); ++line) {
        if (cancelRequested()) throw Error(path, "cancelled");
        row.get(image, rowOfLine(box, line), box.x, box.r, zefra::kRGB);
        interleave(row, pixels);
        file->writeLine(pixels.data());
    }
    file->finish();
}

}  // namespace host
