// Evaluation of a lattice, a colour at a time, next to the plain way: the eight corners through
// get(r, g, b), in double precision.

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <random>
#include <vector>

#include "bench/Tables.h"
#include "lut/Interpolation.h"

namespace {

namespace ol = Orlith::LUT;

std::vector<ol::RGB> randomColours() {
    std::mt19937 generator(1);
    std::uniform_real_distribution<float> unit(0.0F, 1.0F);
    std::vector<ol::RGB> colours(4096);
    for (ol::RGB& colour : colours) {
        colour = ol::RGB(unit(generator), unit(generator), unit(generator));
    }
    return colours;
}

template <class Evaluate>
void evaluateAll(benchmark::State& state, Evaluate evaluate) {
    const auto lut = bench::look(static_cast<int>(state.range(0)));
    lut->outputShaper = {};
    const auto colours = randomColours();
    for (auto _ : state) {
        for (const ol::RGB& colour : colours)
            benchmark::DoNotOptimize(evaluate(*lut, colour));
    }
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(colours.size()));
}

ol::RGB plainTrilinear(const ol::LUT& lut, const ol::RGB& point) {
    const int sizes[] = {lut.width(), lut.height(), lut.depth()};
    int index[3][2];
    double weight[3][2];
    for (unsigned c = 0; c < 3; ++c) {
        const double x =
            (static_cast<double>(point[c]) - static_cast<double>(lut.transform[3][c])) /
            static_cast<double>(lut.transform[c][c]);
        index[c][0] = std::clamp(static_cast<int>(std::floor(x)), 0, sizes[c] - 1);
        index[c][1] = std::min(index[c][0] + 1, sizes[c] - 1);
        weight[c][1] = x - index[c][0];
        weight[c][0] = 1.0 - weight[c][1];
    }
    double sum[3] = {};
    for (int corner = 0; corner < 8; ++corner) {
        const int r = corner & 1;
        const int g = corner >> 1 & 1;
        const int b = corner >> 2;
        const ol::RGB& sample = lut.get(index[0][r], index[1][g], index[2][b]);
        for (unsigned c = 0; c < 3; ++c) {
            sum[c] += static_cast<double>(sample[c]) * weight[0][r] * weight[1][g] * weight[2][b];
        }
    }
    return {static_cast<float>(sum[0]), static_cast<float>(sum[1]), static_cast<float>(sum[2])};
}

void plain(benchmark::State& state) {
    evaluateAll(state, plainTrilinear);
}

template <ol::InterpolationMode kMode>
void interpolate(benchmark::State& state) {
    evaluateAll(state, [](const ol::LUT& lut, const ol::RGB& colour) {
        return lut.interpolate(colour, kMode, false);
    });
}

BENCHMARK(plain)->Arg(33)->Arg(65);
BENCHMARK_TEMPLATE(interpolate, ol::Step)->Arg(33)->Arg(65);
BENCHMARK_TEMPLATE(interpolate, ol::LinearStaggered)->Arg(33)->Arg(65);
BENCHMARK_TEMPLATE(interpolate, ol::Trilinear)->Arg(33)->Arg(65);
BENCHMARK_TEMPLATE(interpolate, ol::Cubic)->Arg(33)->Arg(65);

}  // namespace

BENCHMARK_MAIN();
