#include "zefra/Row.h"

#include <algorithm>

#include "zefra/Iop.h"

namespace zefra {

Row::Row(int left, int right) : left_(left), right_(std::max(left, right)) {
    for (auto& channel : channels_)
        channel.resize(static_cast<std::size_t>(right_ - left_));
}

void Row::get(Iop& image, int y, int x, int r, ChannelMask channels) {
    image.engine(y, x, r, channels, *this);
}

}  // namespace zefra
