#pragma once

namespace zefra {

/// Colour channels, as bits of a mask.
enum Channel : unsigned { kRed = 1, kGreen = 2, kBlue = 4 };
using ChannelMask = unsigned;
constexpr ChannelMask kRGB = kRed | kGreen | kBlue;

/// An area of pixels: x <= column < r, y <= row < t. Rows are counted upward from the bottom.
struct Box {
    int x = 0;
    int y = 0;
    int r = 0;
    int t = 0;

    int width() const { return r - x; }
    int height() const { return t - y; }
};

}  // namespace zefra
