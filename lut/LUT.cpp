#include "lut/LUT.h"

#include "lut/CurveLookup.h"
#include "lut/Exception.h"

namespace Orlith::LUT {

LUT::LUT() {
    transform.set_identity();
}

LUT::~LUT() = default;

int LUT::width() const {
    throw Exception("width: not available");
}

int LUT::height() const {
    throw Exception("height: not available");
}

int LUT::depth() const {
    throw Exception("depth: not available");
}

void LUT::resize(int) {
    throw Exception("resize: not available");
}

void LUT::resize(int, int, int) {
    throw Exception("resize: not available");
}

RGB& LUT::get(int, int, int) {
    throw Exception("get: not available");
}

const RGB& LUT::get(int, int, int) const {
    throw Exception("get: not available");
}

RGB& LUT::get(int) {
    throw Exception("get: not available");
}

const RGB& LUT::get(int) const {
    throw Exception("get: not available");
}

float* LUT::data() {
    return values.data();
}

const float* LUT::data() const {
    return values.data();
}

std::uint32_t LUT::dataSize() const {
    return static_cast<std::uint32_t>(values.size() * sizeof(RGB));
}

RGB LUT::applyShaper(const RGB& point) const {
    RGB position = point;
    if (!inputShaper.empty()) {
        for (unsigned c = 0; c < 3; ++c) {
            position[c] = locateInCurve(inputShaper.entries.data(), inputShaper.entries.size(), c,
                                        inputShaper.counts[c], point[c]);
        }
    }
    if (!outputShaper.empty()) {
        for (unsigned c = 0; c < 3; ++c) {
            position[c] = interpolateCurve(outputShaper.entries.data(), outputShaper.entries.size(),
                                           c, outputShaper.counts[c], position[c]);
        }
    }
    return position;
}

void LUT::minmax(RGB&, RGB&) const {
    throw Exception("minmax: not available");
}

void setUnitDomain(LUT& lut, int width, int height, int depth) {
    lut.transform.set_identity();
    lut.transform[0][0] = 1.0F / static_cast<float>(width - 1);
    lut.transform[1][1] = 1.0F / static_cast<float>(height - 1);
    lut.transform[2][2] = 1.0F / static_cast<float>(depth - 1);
}

}  // namespace Orlith::LUT
