#include "orlith/ShownPicture.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

#include "host/Host.h"
#include "orlith/ImageOptions.h"
#include "report/Base64.h"
#include "zefra/Row.h"

namespace orlith {
namespace {

constexpr int kMostWidth = 960;
constexpr int kMostHeight = 720;

}  // namespace

report::Picture readForPage(const std::string& path, const host::ImageChoice& choice) {
    host::Host host;
    zefra::Iop& image = openImage(createRead(host, path, choice));
    const zefra::Box box = image.box();
    image.request(box.x, box.y, box.r, box.t, zefra::kRGB, 0);
    const double shrink = std::max({1.0, static_cast<double>(box.width()) / kMostWidth,
                                    static_cast<double>(box.height()) / kMostHeight});
    report::Picture picture;
    picture.width = std::max(1, static_cast<int>(box.width() / shrink));
    picture.height = std::max(1, static_cast<int>(box.height() / shrink));
    const auto pixelCount =
        static_cast<std::size_t>(picture.width) * static_cast<std::size_t>(picture.height);
    picture.pixels.resize(3 * pixelCount);
    std::vector<float> weights(pixelCount);

    zefra::Row row(box.x, box.r);
    for (int line = 0; line < box.height(); ++line) {
        row.get(image, box.t - 1 - line, box.x, box.r, zefra::kRGB);  // rows count upward
        const int y = static_cast<int>(std::int64_t{line} * picture.height / box.height());
        for (int column = 0; column < box.width(); ++column) {
            const int x = static_cast<int>(std::int64_t{column} * picture.width / box.width());
            const auto pixel =
                static_cast<std::size_t>(y) * static_cast<std::size_t>(picture.width) +
                static_cast<std::size_t>(x);
            picture.pixels[3 * pixel] += row.pixels(zefra::kRed)[column];
            picture.pixels[3 * pixel + 1] += row.pixels(zefra::kGreen)[column];
            picture.pixels[3 * pixel + 2] += row.pixels(zefra::kBlue)[column];
            weights[pixel] += 1.0F;
        }
    }
    for (std::size_t i = 0; i < picture.pixels.size(); ++i)
        picture.pixels[i] /= weights[i / 3];
    return picture;
}

std::string dataAddress(const report::Picture& picture, const std::string& folder) {
    const std::string path = folder + "/picture.jpg";
    const host::ImageWindow window{0, 0, picture.width, picture.height};
    const auto writer = host::imageCodec().create(path, {window, window}, "uint8");
    const std::size_t lineFloats = 3 * static_cast<std::size_t>(picture.width);
    std::vector<float> line(lineFloats);
    for (std::size_t start = 0; start < picture.pixels.size(); start += lineFloats) {
        std::transform(
            picture.pixels.begin() + static_cast<std::ptrdiff_t>(start),
            picture.pixels.begin() + static_cast<std::ptrdiff_t>(start + lineFloats), line.begin(),
            [](float value) { return std::isnan(value) ? 0.0F : std::clamp(value, 0.0F, 1.0F); });
        writer->writeLine(line.data());
    }
    writer->finish();
    std::ifstream file(path, std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(file), {}};
    std::remove(path.c_str());
    return "data:image/jpeg;base64," + report::base64(bytes.data(), bytes.size());
}

}  // namespace orlith
