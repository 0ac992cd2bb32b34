#include "bench/Tables.h"

#include <unistd.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <filesystem>

#include "lut/RampFill.h"

namespace bench {

namespace ol = Orlith::LUT;

boost::shared_ptr<ol::LUT3D> look(int points) {
    auto lut = boost::make_shared<ol::LUT3D>();
    lut->resize(points);
    const auto curve = [&](int index, float gamma) {
        return std::pow(static_cast<float>(index) / static_cast<float>(points - 1), gamma);
    };
    for (int b = 0; b < points; ++b) {
        for (int g = 0; g < points; ++g) {
            for (int r = 0; r < points; ++r) {
                lut->get(r, g, b) = ol::RGB(0.9F * curve(r, 0.45F) + 0.1F * curve(g, 1.0F),
                                            0.8F * curve(g, 0.5F) + 0.2F * curve(b, 1.0F),
                                            0.9F * curve(b, 0.6F) + 0.1F * curve(r, 1.0F));
            }
        }
    }
    ol::setUnitDomain(*lut, points, points, points);
    ol::fillLinearRamp(lut->outputShaper.entries, 1024, 1);
    lut->outputShaper.counts.fill(1024.0F);
    return lut;
}

ScratchFile::ScratchFile(const std::string& extension)
    : path_((std::filesystem::temp_directory_path() /
             ("orlith-bench-" + std::to_string(getpid()) + extension))
                .string()) {}

ScratchFile::~ScratchFile() {
    std::error_code ignored;
    std::filesystem::remove(path_, ignored);
}

}  // namespace bench
