#pragma once

#include "zefra/Image.h"

namespace host {

/// Image files store their top line first, the host counts rows upward from the bottom: the line of
/// a row, or the row of a line counted within the box. The one place that turns images over.
inline int lineOfRow(const zefra::Box& box, int y) {
    return box.t - 1 - y;
}
inline int rowOfLine(const zefra::Box& box, int line) {
    return box.t - 1 - line;
}

}  // namespace host
