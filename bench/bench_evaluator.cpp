// Packed colours through a lattice: the Evaluator next to a plain loop of the same method, in
// single precision, and next to copying the colours. The first argument is the number of points a
// side, the second tells random colours (0) from those of a picture (1).

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cmath>
#include <cstring>
#include <random>
#include <vector>

#include "bench/Tables.h"
#include "lut/Evaluator.h"

namespace {

namespace ol = Orlith::LUT;
using Method = ol::Evaluator::Method;

constexpr int kPixelsASide = 512;
constexpr std::size_t kColourCount = std::size_t{kPixelsASide} * kPixelsASide;

std::vector<float> randomColours() {
    std::mt19937 generator(1);
    std::uniform_real_distribution<float> unit(0.0F, 1.0F);
    std::vector<float> colours(3 * kColourCount);
    std::generate(colours.begin(), colours.end(), [&] { return unit(generator); });
    return colours;
}

/// Gradients with a little grain, some of it black or white: neighbours are alike.
std::vector<float> pictureColours() {
    std::mt19937 generator(1);
    std::normal_distribution<float> grain(0.0F, 0.004F);
    std::vector<float> colours;
    for (int y = 0; y < kPixelsASide; ++y) {
        for (int x = 0; x < kPixelsASide; ++x) {
            const float u = static_cast<float>(x) / kPixelsASide;
            const float v = static_cast<float>(y) / kPixelsASide;
            const float light = 0.5F + 0.6F * std::sin(5.0F * u + 2.0F * v) * std::cos(4.0F * v);
            for (const float tint : {0.1F, 0.0F, -0.1F}) {
                const float value = light + tint * std::sin(9.0F * u) + grain(generator);
                colours.push_back(std::clamp(value, 0.0F, 1.0F));
            }
        }
    }
    return colours;
}

/// The lattice as the plain loops take it: a domain from 0 to 1, the same number of points a side.
struct Cube {
    const float* samples;
    int points;

    const float* sample(int r, int g, int b) const {
        return samples + std::ptrdiff_t{3} * ((b * points + g) * points + r);
    }

    float position(float value) const {
        const auto last = static_cast<float>(points - 1);
        return std::min(std::max(value * last, 0.0F), last);
    }
};

float mix(float a, float b, float weight) {
    return a + weight * (b - a);
}

struct Cell {
    int lower[3];
    int upper[3];
    float fraction[3];
};

Cell findCell(const Cube& cube, const float* colour) {
    Cell cell;
    for (int c = 0; c < 3; ++c) {
        const float x = cube.position(colour[c]);
        cell.lower[c] = static_cast<int>(x);
        cell.upper[c] = std::min(cell.lower[c] + 1, cube.points - 1);
        cell.fraction[c] = x - static_cast<float>(cell.lower[c]);
    }
    return cell;
}

void plainStep(const Cube& cube, const float* colour, float* result) {
    const Cell cell = findCell(cube, colour);
    std::memcpy(result, cube.sample(cell.lower[0], cell.lower[1], cell.lower[2]),
                3 * sizeof(float));
}

void plainTrilinear(const Cube& cube, const float* colour, float* result) {
    const auto& [lower, upper, f] = findCell(cube, colour);
    const float* s000 = cube.sample(lower[0], lower[1], lower[2]);
    const float* s100 = cube.sample(upper[0], lower[1], lower[2]);
    const float* s010 = cube.sample(lower[0], upper[1], lower[2]);
    const float* s110 = cube.sample(upper[0], upper[1], lower[2]);
    const float* s001 = cube.sample(lower[0], lower[1], upper[2]);
    const float* s101 = cube.sample(upper[0], lower[1], upper[2]);
    const float* s011 = cube.sample(lower[0], upper[1], upper[2]);
    const float* s111 = cube.sample(upper[0], upper[1], upper[2]);
    for (int c = 0; c < 3; ++c) {
        const float below = mix(mix(s000[c], s100[c], f[0]), mix(s010[c], s110[c], f[0]), f[1]);
        const float above = mix(mix(s001[c], s101[c], f[0]), mix(s011[c], s111[c], f[0]), f[1]);
        result[c] = mix(below, above, f[2]);
    }
}

void plainTetrahedral(const Cube& cube, const float* colour, float* result) {
    const auto& [lower, upper, f] = findCell(cube, colour);
    const float* first = cube.sample(lower[0], lower[1], lower[2]);
    const float* last = cube.sample(upper[0], upper[1], upper[2]);
    const auto blend = [&](const float* second, const float* third, float f0, float f1, float f2) {
        for (int c = 0; c < 3; ++c) {
            result[c] = (1.0F - f0) * first[c] + (f0 - f1) * second[c] + (f1 - f2) * third[c] +
                        f2 * last[c];
        }
    };
    if (f[0] >= f[1]) {
        if (f[1] >= f[2]) {
            blend(cube.sample(upper[0], lower[1], lower[2]),
                  cube.sample(upper[0], upper[1], lower[2]), f[0], f[1], f[2]);
        } else if (f[0] >= f[2]) {
            blend(cube.sample(upper[0], lower[1], lower[2]),
                  cube.sample(upper[0], lower[1], upper[2]), f[0], f[2], f[1]);
        } else {
            blend(cube.sample(lower[0], lower[1], upper[2]),
                  cube.sample(upper[0], lower[1], upper[2]), f[2], f[0], f[1]);
        }
    } else if (f[2] >= f[1]) {
        blend(cube.sample(lower[0], lower[1], upper[2]), cube.sample(lower[0], upper[1], upper[2]),
              f[2], f[1], f[0]);
    } else if (f[2] >= f[0]) {
        blend(cube.sample(lower[0], upper[1], lower[2]), cube.sample(lower[0], upper[1], upper[2]),
              f[1], f[2], f[0]);
    } else {
        blend(cube.sample(lower[0], upper[1], lower[2]), cube.sample(upper[0], upper[1], lower[2]),
              f[1], f[0], f[2]);
    }
}

/// Eight samples for each channel, whose own axis is half a cell off.
void plainStaggered(const Cube& cube, const float* colour, float* result) {
    const int last = cube.points - 1;
    int nearest[3];
    int beside[3];
    int above[3];
    float weight[3];
    float own[3];
    for (int c = 0; c < 3; ++c) {
        const float x = cube.position(colour[c]);
        nearest[c] = static_cast<int>(x + 0.5F);
        const float offset = x - static_cast<float>(nearest[c]);
        beside[c] = offset > 0.0F ? std::min(nearest[c] + 1, last) : std::max(nearest[c] - 1, 0);
        above[c] = std::min(nearest[c] + 1, last);
        weight[c] = std::fabs(offset);
        own[c] = offset + 0.5F;
    }
    const auto red = [&](int r) {
        return mix(mix(cube.sample(r, nearest[1], nearest[2])[0],
                       cube.sample(r, nearest[1], beside[2])[0], weight[2]),
                   mix(cube.sample(r, beside[1], nearest[2])[0],
                       cube.sample(r, beside[1], beside[2])[0], weight[2]),
                   weight[1]);
    };
    const auto green = [&](int g) {
        return mix(mix(cube.sample(nearest[0], g, nearest[2])[1],
                       cube.sample(nearest[0], g, beside[2])[1], weight[2]),
                   mix(cube.sample(beside[0], g, nearest[2])[1],
                       cube.sample(beside[0], g, beside[2])[1], weight[2]),
                   weight[0]);
    };
    const auto blue = [&](int b) {
        return mix(mix(cube.sample(nearest[0], nearest[1], b)[2],
                       cube.sample(nearest[0], beside[1], b)[2], weight[1]),
                   mix(cube.sample(beside[0], nearest[1], b)[2],
                       cube.sample(beside[0], beside[1], b)[2], weight[1]),
                   weight[0]);
    };
    result[0] = mix(red(nearest[0]), red(above[0]), own[0]);
    result[1] = mix(green(nearest[1]), green(above[1]), own[1]);
    result[2] = mix(blue(nearest[2]), blue(above[2]), own[2]);
}

/// Catmull-Rom weights, 4 x 4 x 4 samples, red first; indices stop at the faces.
void plainCubic(const Cube& cube, const float* colour, float* result) {
    float weight[3][4];
    int index[3][4];
    for (int c = 0; c < 3; ++c) {
        const float x = cube.position(colour[c]);
        const int lower = static_cast<int>(x);
        const float t = x - static_cast<float>(lower);
        weight[c][0] = 0.5F * t * (t * (2.0F - t) - 1.0F);
        weight[c][1] = 0.5F * (t * t * (3.0F * t - 5.0F) + 2.0F);
        weight[c][2] = 0.5F * t * (t * (4.0F - 3.0F * t) + 1.0F);
        weight[c][3] = 0.5F * t * t * (t - 1.0F);
        for (int i = 0; i < 4; ++i)
            index[c][i] = std::clamp(lower - 1 + i, 0, cube.points - 1);
    }
    float sum[3] = {};
    for (int b = 0; b < 4; ++b) {
        float plane[3] = {};
        for (int g = 0; g < 4; ++g) {
            float row[3] = {};
            for (int r = 0; r < 4; ++r) {
                const float* sample = cube.sample(index[0][r], index[1][g], index[2][b]);
                for (int c = 0; c < 3; ++c)
                    row[c] += weight[0][r] * sample[c];
            }
            for (int c = 0; c < 3; ++c)
                plane[c] += weight[1][g] * row[c];
        }
        for (int c = 0; c < 3; ++c)
            sum[c] += weight[2][b] * plane[c];
    }
    std::memcpy(result, sum, sizeof(sum));
}

template <class Apply>
void applyToAll(benchmark::State& state, Apply apply) {
    const auto colours = state.range(1) == 0 ? randomColours() : pictureColours();
    std::vector<float> results(colours.size());
    for (auto _ : state) {
        apply(colours.data(), results.data());
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(kColourCount));
}

boost::shared_ptr<ol::LUT3D> table(benchmark::State& state) {
    const auto lut = bench::look(static_cast<int>(state.range(0)));
    lut->outputShaper = {};
    return lut;
}

template <void (*kEvaluate)(const Cube&, const float*, float*)>
void plain(benchmark::State& state) {
    const auto lut = table(state);
    const Cube cube{lut->data(), lut->width()};
    applyToAll(state, [&](const float* colours, float* results) {
        for (std::size_t i = 0; i < 3 * kColourCount; i += 3)
            kEvaluate(cube, colours + i, results + i);
    });
}

template <Method kMethod>
void evaluator(benchmark::State& state) {
    const ol::Evaluator evaluator(table(state), kMethod);
    applyToAll(state, [&](const float* colours, float* results) {
        evaluator.apply(colours, results, kColourCount);
    });
}

void copy(benchmark::State& state) {
    applyToAll(state, [](const float* colours, float* results) {
        std::memcpy(results, colours, 3 * kColourCount * sizeof(float));
    });
}

void sizesAndColours(benchmark::internal::Benchmark* benchmark) {
    benchmark->ArgsProduct({{33, 65}, {0, 1}});
}

BENCHMARK(copy)->Args({0, 0});
BENCHMARK_TEMPLATE(plain, plainStep)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(evaluator, Method::Step)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(plain, plainStaggered)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(evaluator, Method::Staggered)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(plain, plainTrilinear)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(evaluator, Method::Trilinear)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(plain, plainTetrahedral)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(evaluator, Method::Tetrahedral)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(plain, plainCubic)->Apply(sizesAndColours);
BENCHMARK_TEMPLATE(evaluator, Method::Cubic)->Apply(sizesAndColours);

}  // namespace

BENCHMARK_MAIN();
