#include "orlith/table/Facts.h"

#include <cmath>
#include <limits>

#include "lut/evaluation/Look.h"
#include "lut/io/Lattice.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

/// Whether a run of samples of one channel goes one way only.
class Direction {
public:
    void add(float value) {
        if (count_++ > 0) {
            rises_ = rises_ && value >= last_;
            falls_ = falls_ && value <= last_;
        }
        last_ = value;
    }
    bool isMonotone() const { return rises_ || falls_; }

private:
    float last_ = 0.0F;
    int count_ = 0;
    bool rises_ = true;
    bool falls_ = true;
};

bool isMonotone(const ol::LUT& lut, const ol::LatticeSize& size, unsigned channel) {
    const int lengths[] = {size.width, size.height, size.depth};
    const unsigned others[] = {channel == 0 ? 1U : 0U, channel == 2 ? 1U : 2U};
    int at[3];
    for (at[others[1]] = 0; at[others[1]] < lengths[others[1]]; ++at[others[1]]) {
        for (at[others[0]] = 0; at[others[0]] < lengths[others[0]]; ++at[others[0]]) {
            Direction direction;
            for (at[channel] = 0; at[channel] < lengths[channel]; ++at[channel]) {
                const ol::LatticePosition point{at[0], at[1], at[2]};
                direction.add(lut.data()[3 * point.element(size) + channel]);
            }
            if (!direction.isMonotone()) return false;
        }
    }
    return true;
}

}  // namespace

ol::RGB inputColour(const ol::LUT& lut, int r, int g, int b) {
    const int index[] = {r, g, b};
    ol::RGB colour;
    for (unsigned c = 0; c < 3; ++c) {
        colour[c] = static_cast<float>(index[c]) * lut.transform[c][c] + lut.transform[3][c];
    }
    return colour;
}

double identityDeviation(const boost::shared_ptr<const ol::LUT>& lut) {
    const ol::Evaluator evaluator(lut);
    double largest = 0.0;
    forEachInput(*lut, false, [&](const ol::RGB& colour) {
        ol::RGB result;
        evaluator.apply(colour.data_block(), result.data_block(), 1);
        for (unsigned c = 0; c < 3; ++c) {
            const double deviation =
                std::fabs(static_cast<double>(result[c]) - static_cast<double>(colour[c]));
            if (std::isnan(deviation)) {
                largest = std::numeric_limits<double>::infinity();
            } else if (deviation > largest) {
                largest = deviation;
            }
        }
    });
    return largest;
}

Facts factsOf(const ol::LUT& lut) {
    Facts facts;
    facts.min.fill(std::numeric_limits<float>::infinity());
    facts.max.fill(-std::numeric_limits<float>::infinity());
    // A curve is looked at as a lattice of one line; its three channels share that line's axis.
    const ol::LatticeSize size =
        lut.is1D() ? ol::LatticeSize{lut.width(), 1, 1} : ol::LatticeSize::of(lut);
    const float* sample = lut.data();
    ol::forEachRedFastest(size, [&](std::size_t) {
        for (unsigned c = 0; c < 3; ++c, ++sample) {
            if (*sample < facts.min[c]) facts.min[c] = *sample;
            if (*sample > facts.max[c]) facts.max[c] = *sample;
        }
    });
    for (unsigned c = 0; c < 3; ++c) {
        if (facts.min[c] > facts.max[c]) {
            facts.min[c] = facts.max[c] = std::numeric_limits<float>::quiet_NaN();
        }
        if (lut.is1D()) {
            Direction direction;
            for (int i = 0; i < lut.width(); ++i)
                direction.add(lut.get(i)[c]);
            facts.isMonotone[c] = direction.isMonotone();
        } else {
            facts.isMonotone[c] = isMonotone(lut, size, c);
        }
    }
    return facts;
}

}  // namespace orlith
