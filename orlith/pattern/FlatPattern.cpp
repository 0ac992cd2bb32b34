#include "orlith/pattern/FlatPattern.h"

#include <cstdint>

#include "zefra/PatternLayout.h"
#include "zefra/Row.h"

namespace orlith {

FlatPattern::FlatPattern(zefra::Node& node, const zefra::Box& box, const Orlith::LUT::LUT3D& table)
    : Iop(node), imageBox_(box), table_(table) {}

void FlatPattern::_validate(bool) {
    setBox(imageBox_);
}

void FlatPattern::engine(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) {
    constexpr int kPatchPixels = zefra::PatternLayout::kPatchPixels;
    const int columns = imageBox_.width() / kPatchPixels;
    const auto points = std::int64_t{table_.width()};
    std::size_t channelIndex = 0;
    for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue}) {
        const float* const samples = table_.data() + channelIndex++;
        if ((channels & channel) == 0) continue;
        float* const out = row.writable(channel);
        for (int column = x; column < r; ++column) {
            const std::int64_t patch =
                std::int64_t{y / kPatchPixels} * columns + column / kPatchPixels;
            const bool isPoint = y >= 0 && column >= 0 && column / kPatchPixels < columns &&
                                 patch < points * points * points;
            out[column - row.left()] = isPoint ? samples[3 * patch] : 0.0F;
        }
    }
}

}  // namespace orlith
