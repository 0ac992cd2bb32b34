#include "orlith/bake/LookOp.h"

#include <utility>

#include "zefra/Row.h"

namespace orlith {
namespace {

constexpr zefra::Channel kChannels[] = {zefra::kRed, zefra::kGreen, zefra::kBlue};

}  // namespace

LookOp::LookOp(zefra::Node& node, zefra::Iop& input, Orlith::LUT::ColourWay look)
    : PixelIop(node), look_(std::move(look)) {
    setInput(0, &input);
}

void LookOp::pixelEngine(const zefra::Row& in, zefra::ChannelMask channels, zefra::Row& out) {
    const auto width = static_cast<std::size_t>(in.right() - in.left());
    colours_.resize(3 * width);
    for (std::size_t c = 0; c < 3; ++c) {
        const float* const from = in.pixels(kChannels[c]);
        for (std::size_t x = 0; x < width; ++x)
            colours_[3 * x + c] = from[x];
    }
    look_(colours_.data(), width);
    for (std::size_t c = 0; c < 3; ++c) {
        if ((channels & kChannels[c]) == 0) continue;
        float* const to = out.writable(kChannels[c]) + (in.left() - out.left());
        for (std::size_t x = 0; x < width; ++x)
            to[x] = colours_[3 * x + c];
    }
}

}  // namespace orlith
