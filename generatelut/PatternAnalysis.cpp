#include "generatelut/PatternAnalysis.h"

#include <boost/smart_ptr/make_shared.hpp>

#include "lut/RampFill.h"
#include "zefra/PatternLayout.h"

namespace generatelut {
namespace {

using Layout = zefra::PatternLayout;

}  // namespace

PatternSize PatternSize::ofImage(int width, int height) {
    PatternSize size;
    size.patchColumns = width / Layout::kPatchPixels;
    size.patchRows = height / Layout::kPatchPixels;
    const int points = Layout::points(size.patchColumns);
    size.lutSizeR = size.lutSizeG = size.lutSizeB = points;
    // More points than 32 bits count are refused when the table is sized.
    size.lutEntryCount = static_cast<int>(std::int64_t{points} * points * points);
    return size;
}

int PatternSize::pixelWidth() const {
    return patchColumns * Layout::kPatchPixels;
}

int PatternSize::pixelHeight() const {
    return patchRows * Layout::kPatchPixels;
}

bool PatternSize::indexToLattice(int index, int (&rgb)[3]) const {
    rgb[0] = rgb[1] = rgb[2] = 0;
    if (index < 0 || index >= lutEntryCount) return false;
    rgb[0] = index % lutSizeR;
    rgb[1] = index / lutSizeR % lutSizeG;
    rgb[2] = index / lutSizeR / lutSizeG;
    return true;
}

bool PatternSize::indexToColour(int index, float (&rgb)[3]) const {
    rgb[0] = rgb[1] = rgb[2] = 0.0F;
    int point[3];
    if (!indexToLattice(index, point)) return false;
    rgb[0] = static_cast<float>(point[0]) / static_cast<float>(lutSizeR - 1);
    rgb[1] = static_cast<float>(point[1]) / static_cast<float>(lutSizeG - 1);
    rgb[2] = static_cast<float>(point[2]) / static_cast<float>(lutSizeB - 1);
    return true;
}

boost::shared_ptr<Orlith::LUT::LUT3D> analyseFrame(const PatternSize& size, const PreLUT& preLUT,
                                                   Frame& frame) {
    auto lut = boost::make_shared<Orlith::LUT::LUT3D>();
    lut->resize(size.lutSizeR, size.lutSizeG, size.lutSizeB);
    const auto fillRamp =
        preLUT.isLinear ? Orlith::LUT::fillLinearRamp : Orlith::LUT::fillSmoothRamp;
    fillRamp(lut->outputShaper.entries, preLUT.entryCount, 1);

    frame.progressMessage("Analyzing frame");
    const int width = size.pixelWidth();
    const int height = size.pixelHeight();
    bool isCancelled = false;
    int index = 0;
    for (int y = Layout::kPatchCentre; y < height; y += Layout::kPatchPixels) {
        frame.progressFraction(static_cast<double>(y) / height);
        frame.withRow(y, width, [&](const float* red, const float* green, const float* blue) {
            isCancelled = frame.aborted();
            if (isCancelled) return;
            for (int x = Layout::kPatchCentre; x < width; x += Layout::kPatchPixels, ++index) {
                int point[3];
                if (!size.indexToLattice(index, point)) continue;
                lut->get(point[0], point[1], point[2]) =
                    Orlith::LUT::RGB(red[x], green[x], blue[x]);
            }
        });
        if (isCancelled) return {};
    }
    return lut;
}

}  // namespace generatelut
