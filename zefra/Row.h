#pragma once

#include <vector>

#include "zefra/Export.h"
#include "zefra/Image.h"

namespace zefra {

class Iop;

/// Part of one image row: float pixels of red, green and blue from column left() to right() - 1.
class ZEFRA_EXPORT Row {
public:
    /// Black pixels.
    Row(int left, int right);

    int left() const { return left_; }
    int right() const { return right_; }

    /// Fetches pixels x to r - 1 of row y of an image that has been validated; they have to lie
    /// within left() to right().
    void get(Iop& image, int y, int x, int r, ChannelMask channels);

    /// The pixels of one channel; the first float is column left().
    const float* pixels(Channel channel) const { return channels_[index(channel)].data(); }
    float* writable(Channel channel) { return channels_[index(channel)].data(); }

private:
    static int index(Channel channel) { return channel == kRed ? 0 : channel == kGreen ? 1 : 2; }

    int left_;
    int right_;
    std::vector<float> channels_[3];
};

}  // namespace zefra
