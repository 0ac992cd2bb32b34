#include "host/ImageFile.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <limits>
#include <system_error>

#include "host/Error.h"
#include "host/ImageChecks.h"
#include "host/ImageLines.h"

namespace host {
namespace {

namespace fs = std::filesystem;

constexpr std::array<zefra::Channel, 3> kChannels = {zefra::kRed, zefra::kGreen, zefra::kBlue};

/// The file's data window, with rows counted upward from the bottom of its display window.
zefra::Box boxOf(const ImageFrame& frame, const std::string& path) {
    const ImageWindow& data = frame.data;
    const ImageWindow& picture = frame.display.height > 0 ? frame.display : data;
    const std::int64_t bottom = std::int64_t{picture.y} + picture.height;
    const std::int64_t x = data.x;
    const std::int64_t y = bottom - (std::int64_t{data.y} + data.height);
    const std::int64_t r = x + data.width;
    const std::int64_t t = y + data.height;
    constexpr std::int64_t kFarthest = std::numeric_limits<int>::max() / 2;
    if (x < -kFarthest || y < -kFarthest || r > kFarthest || t > kFarthest) {
        throw Error(path, "its data window is too far away");
    }
    return {static_cast<int>(x), static_cast<int>(y), static_cast<int>(r), static_cast<int>(t)};
}

}  // namespace

ImageFile::ImageFile(std::string path, const ImageChoice& choice) : path_(std::move(path)) {
    expectReadableFile(path_);
    std::error_code ignored;
    time_ = fs::last_write_time(path_, ignored);
    byteCount_ = fs::file_size(path_, ignored);

    source_ = imageCodec().open(path_, choice);
    expectCredibleSize(source_->frame().data, path_);
    box_ = boxOf(source_->frame(), path_);
    remark_ = source_->remark();
    sampleType_ = source_->sampleType();
}

bool ImageFile::isCurrent() const {
    std::error_code failure;
    return fs::last_write_time(path_, failure) == time_ &&
           fs::file_size(path_, failure) == byteCount_;
}

void ImageFile::copyRow(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) {
    const bool isInside = y >= box_.y && y < box_.t;
    const int first = std::clamp(box_.x, x, std::max(x, r));
    const int end = std::clamp(box_.r, first, std::max(first, r));
    const float* const line = isInside ? source_->line(lineOfRow(box_, y)) : nullptr;

    for (std::size_t i = 0; i < kChannels.size(); ++i) {
        if ((channels & kChannels[i]) == 0) continue;
        float* const out = row.writable(kChannels[i]);
        const int left = row.left();
        std::fill(out + (x - left), out + (std::max(x, r) - left), 0.0F);
        if (line == nullptr) continue;
        const float* const in = line + i;
        for (int column = first; column < end; ++column)
            out[column - left] = in[static_cast<std::size_t>(column - box_.x) * 3];
    }
}

}  // namespace host
