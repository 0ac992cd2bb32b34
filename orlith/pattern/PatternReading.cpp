#include "orlith/pattern/PatternReading.h"

#include <fmt/format.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <cstdint>

#include "host/Host.h"
#include "orlith/Command.h"
#include "orlith/pattern/PatchExtent.h"
#include "orlith/pattern/PatternOrientation.h"
#include "zefra/PatternLayout.h"
#include "zefra/Row.h"

namespace orlith {
namespace {

using Layout = zefra::PatternLayout;
constexpr int kPatchPixels = Layout::kPatchPixels;

struct PatternSize {
    explicit PatternSize(const zefra::Box& box)
        : columns(box.width() / kPatchPixels),
          rows(box.height() / kPatchPixels),
          points(Layout::points(columns)) {}

    std::int64_t pointCount() const { return std::int64_t{points} * points * points; }
    std::int64_t patchCount() const { return std::int64_t{columns} * rows; }
    bool isUpright() const {
        return columns == Layout::columns(points) && rows == Layout::rows(points);
    }
    /// The points of the pattern that would have this size lying on its side.
    int pointsOfSide() const { return Layout::points(rows); }
    bool isOnItsSide() const {
        return rows == Layout::columns(pointsOfSide()) && columns == Layout::rows(pointsOfSide());
    }

    int columns;
    int rows;
    int points;  // on each side of the cube
};

/// The place of a patch in pixels.
std::string placeOf(int column, int row) {
    return fmt::format("x {} and y {} from the bottom left", column * kPatchPixels,
                       row * kPatchPixels);
}

class Reader {
public:
    Reader(const std::string& name, zefra::Iop& image, bool isForced)
        : name_(name), image_(image), isForced_(isForced), size_(image.box()) {}

    PatternReading read() {
        checkWindow();
        checkSize();
        readRows();
        checkOrientation();
        warnOfPatches();
        return std::move(reading_);
    }

private:
    void refuse(const std::string& text) {
        if (!isForced_) throw Failure(name_ + ": " + text);
        warn(text);
    }
    void warn(const std::string& text) { reading_.warnings.push_back(name_ + ": " + text); }

    void checkWindow() {
        const zefra::Box& box = image_.box();
        if (size_.points < 2 || size_.rows == 0) {
            throw Failure(
                fmt::format("{}: {} x {} pixels are too few for a test pattern (patches "
                            "of {} x {} pixels, 2 points)",
                            name_, box.width(), box.height(), kPatchPixels, kPatchPixels));
        }
        if (box.x != 0 || box.y != 0) {
            refuse(
                fmt::format("its pixels begin at x {} and y {} from the bottom left, a pattern "
                            "begins at 0 and 0 (cropped, or moved?)",
                            box.x, box.y));
        }
    }

    void checkSize() {
        if (size_.isUpright() || size_.isOnItsSide()) return;
        const zefra::Box& box = image_.box();
        refuse(fmt::format(
            "no pattern has {} x {} pixels; the nearest by its width, of {} points, has {} x {} "
            "(resized, cropped or padded?)",
            box.width(), box.height(), size_.points, Layout::columns(size_.points) * kPatchPixels,
            Layout::rows(size_.points) * kPatchPixels));
    }

    void readRows() {
        const int width = size_.columns * kPatchPixels;
        const int height = size_.rows * kPatchPixels;
        reading_.table = boost::make_shared<Orlith::LUT::LUT3D>();
        reading_.table->resize(size_.points);
        image_.request(0, 0, width, height, zefra::kRGB, 0);
        zefra::Row row(0, width);
        PatchRowExtents extents(size_.columns);
        for (int patchRow = 0; patchRow < size_.rows; ++patchRow) {
            if (host::Host::cancelRequested()) throw Cancelled();
            extents.clear();
            for (int y = 0; y < kPatchPixels; ++y) {
                row.get(image_, patchRow * kPatchPixels + y, 0, width, zefra::kRGB);
                extents.add(row);
                if (y == Layout::kPatchCentre) takeCentres(row, patchRow);
            }
            lookAt(extents, patchRow);
        }
    }

    void takeCentres(const zefra::Row& row, int patchRow) {
        const std::int64_t first = std::int64_t{patchRow} * size_.columns;
        const std::int64_t count =
            std::min<std::int64_t>(size_.columns, size_.pointCount() - first);
        if (count <= 0) return;
        float* sample = reading_.table->data() + 3 * first;
        for (std::int64_t column = 0; column < count; ++column) {
            const std::int64_t x = column * kPatchPixels + Layout::kPatchCentre;
            for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue}) {
                *sample = row.pixels(channel)[x];
                if (!std::isfinite(*sample) && wildCount_++ == 0) {
                    wildPlace_ = placeOf(static_cast<int>(column), patchRow);
                }
                ++sample;
            }
        }
    }

    void lookAt(const PatchRowExtents& extents, int patchRow) {
        for (int column = 0; column < size_.columns; ++column) {
            const PatchExtent patch = extents.patch(column);
            border_.set(column, patchRow, patch);
            if (std::int64_t{patchRow} * size_.columns + column >= size_.pointCount()) continue;
            const double unevenness = patch.unevenness();
            if (unevenness <= 1.0) continue;
            ++unevenCount_;
            if (unevenness > largestUnevenness_) {
                largestUnevenness_ = unevenness;
                spread_ = patch.spread();
                unevenPlace_ = placeOf(column, patchRow);
            }
        }
    }

    void checkOrientation() {
        if (size_.isUpright()) {
            const auto names = findOrientations(border_, size_.points);
            if (!names.empty()) return refuseOrientation(size_.points, names);
            warnOfPadding();
            warnOfOrientation();
        } else if (size_.isOnItsSide()) {
            auto names = findOrientations(border_, size_.pointsOfSide());
            if (names.empty()) names = {"turned by 90 degrees", "transposed"};
            refuseOrientation(size_.pointsOfSide(), names);
        }
    }

    void refuseOrientation(int points, const std::vector<std::string>& names) {
        refuse(fmt::format("its pattern of {} points is {}; undo that", points,
                           fmt::join(names, " or ")));
    }

    /// Of a pattern that may be upright.
    void warnOfPadding() {
        const double gap = paddingGap(border_, size_.points);
        if (gap > spread_) {  // otherwise it is what has made patches uneven
            warn(fmt::format(
                "the padding behind the last patch should have the colour of the first, "
                "and differs by {:.2g} (a vignette, a logo, or the pattern of another program?)",
                gap));
        }
    }

    /// Of a pattern that no padding holds upright.
    void warnOfOrientation() {
        const auto names = findSmootherOrientations(*reading_.table);
        if (names.empty()) return;
        warn(fmt::format("its pattern of {} points seems to be {}: its colours would be in order",
                         size_.points, fmt::join(names, " or ")));
    }

    void warnOfPatches() {
        if (unevenCount_ > 0) {
            warn(fmt::format(
                "{} of {} patches are not of one colour, pixels differ by up to {:.2g}, "
                "most in the patch at {} (blur, sharpening, grain, dither, resizing "
                "or lossy compression?)",
                unevenCount_, std::min(size_.pointCount(), size_.patchCount()), spread_,
                unevenPlace_));
        }
        if (wildCount_ > 0) {
            warn(
                fmt::format("{} of {} samples are not finite, the first in the patch at {} (a "
                            "division by zero, the logarithm of a negative number?)",
                            wildCount_, 3 * size_.pointCount(), wildPlace_));
        }
    }

    const std::string& name_;
    zefra::Iop& image_;
    const bool isForced_;
    const PatternSize size_;
    PatternReading reading_;
    PatchBorder border_{size_.columns, size_.rows};

    std::int64_t unevenCount_ = 0;  // patches
    double largestUnevenness_ = 0.0;
    double spread_ = 0.0;  // of the most uneven one
    std::string unevenPlace_;
    std::int64_t wildCount_ = 0;  // samples of the table that are not finite
    std::string wildPlace_;       // of the first
};

}  // namespace

PatternReading readPattern(const std::string& name, zefra::Iop& image, bool isForced) {
    return Reader(name, image, isForced).read();
}

}  // namespace orlith
