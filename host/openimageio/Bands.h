#pragma once

#include <cstddef>
#include <functional>
#include <list>
#include <memory>

#include "host/openimageio/Lines.h"

namespace host::openimageio {

/// An image that is decoded in bands of lines, of which the last two are kept.
///
///     line 0            +---------------+
///                       | band 0        |   bands hold whole blocks, which are decoded together
///     bandLines         +---------------+
///                       | last band     |   up to twice as high: what is left over belongs to it
///     height            +---------------+
///
/// A file that is cut off is noticed whatever lines are asked for, since the bands at both ends are
/// decoded first. A band has 16 lines or more, if the image has: whoever looks at one line in seven
/// comes through all of them, and so past all damage.
class Bands final : public Lines {
public:
    /// Fills lines first to end - 1.
    using Decode = std::function<void(int first, int end, float* rgb)>;

    /// @param blockLines  what the file decodes together, from line 0 on; 1 to height
    Bands(int width, int height, int blockLines, Decode decode);

    const float* line(int line) override;

private:
    struct Band {
        int index = -1;  // none
        std::unique_ptr<float[]> rgb;
    };
    const Band& band(int index);
    int linesIn(int index) const;

    const std::size_t lineFloats_;
    const int height_;
    const int bandLines_;
    const int bandCount_;
    const Decode decode_;
    std::list<Band> bands_;  // the last one used first
    bool isWhole_ = false;   // both ends are there
};

}  // namespace host::openimageio
