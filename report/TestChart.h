#pragma once

#include <vector>

namespace report {

/// A picture of r g b triples, the top line first.
struct Picture {
    int width = 0;
    int height = 0;
    std::vector<float> pixels;
};

/// A picture to send through tables, of values from 0 to 1. From the top: all hues from white by
/// way of the full colour to black, where folds and jumps show as edges; a ramp and steps of grey,
/// where tints and clips show; ramps of red, green and blue; colours of skin, plants, sky and
/// fabrics.
Picture testChart(int width, int height);

}  // namespace report
