#include "orlith/PatternTable.h"

#include <fmt/format.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cstdint>

#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "zefra/PatternLayout.h"
#include "zefra/Row.h"

namespace orlith {
namespace {

using Layout = zefra::PatternLayout;

struct Patches {
    explicit Patches(const zefra::Box& box)
        : columns(box.width() / Layout::kPatchPixels),
          rows(box.height() / Layout::kPatchPixels),
          points(Layout::points(columns)) {}

    int columns;
    int rows;
    int points;  // on each side of the cube
};

}  // namespace

void checkPattern(const std::string& path, const zefra::Iop& image) {
    const zefra::Box& box = image.box();
    const Patches patches(box);
    if (patches.points < 2) {
        throw Failure(fmt::format(
            "{}: {} x {} pixels are too few for a test pattern (patches of {} x {} pixels, 2 "
            "points)",
            path, box.width(), box.height(), Layout::kPatchPixels, Layout::kPatchPixels));
    }
    const std::int64_t held = std::int64_t{patches.columns} * patches.rows;
    const std::int64_t wanted = std::int64_t{patches.points} * patches.points * patches.points;
    if (held < wanted) {
        warn(fmt::format("{}: holds {} patches, a {}-point pattern has {}", path, held,
                         patches.points, wanted));
    } else if (patches.columns != Layout::columns(patches.points)) {
        warn(fmt::format("{}: is {} patches wide, a {}-point pattern {}", path, patches.columns,
                         patches.points, Layout::columns(patches.points)));
    }
}

boost::shared_ptr<Orlith::LUT::LUT3D> tableOfPattern(zefra::Iop& image) {
    const Patches patches(image.box());
    auto lut = boost::make_shared<Orlith::LUT::LUT3D>();
    lut->resize(patches.points);
    const int width = patches.columns * Layout::kPatchPixels;
    const std::int64_t pointCount = std::int64_t{patches.points} * patches.points * patches.points;
    float* sample = lut->data();
    zefra::Row row(0, width);
    for (std::int64_t index = 0; index < pointCount; ++index, sample += 3) {
        const auto column = static_cast<int>(index % patches.columns);
        const auto patchRow = static_cast<int>(index / patches.columns);
        if (patchRow == patches.rows) break;
        if (column == 0) {
            row.get(image, patchRow * Layout::kPatchPixels + Layout::kPatchCentre, 0, width,
                    zefra::kRGB);
        }
        const int x = column * Layout::kPatchPixels + Layout::kPatchCentre;
        sample[0] = row.pixels(zefra::kRed)[x];
        sample[1] = row.pixels(zefra::kGreen)[x];
        sample[2] = row.pixels(zefra::kBlue)[x];
    }
    return lut;
}

}  // namespace orlith
