#include "orlith/table/ColourOptions.h"

#include <CLI/CLI.hpp>
#include <string>
#include <utility>
#include <vector>

#include "orlith/Command.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;
using Method = ol::Evaluator::Method;

constexpr std::pair<const char*, Method> kMethods[] = {{"step", Method::Step},
                                                       {"staggered", Method::Staggered},
                                                       {"trilinear", Method::Trilinear},
                                                       {"tetrahedral", Method::Tetrahedral},
                                                       {"cubic", Method::Cubic}};

}  // namespace

ol::Evaluator::Outside ColourOptions::outside() const {
    return extrapolates ? ol::Evaluator::Outside::Extrapolate : ol::Evaluator::Outside::Clamp;
}

ol::Evaluator ColourOptions::evaluator(const boost::shared_ptr<const ol::LUT>& table) const {
    return ol::Evaluator(table, method, outside());
}

ol::InterpolationMode ColourOptions::bookMode() const {
    switch (method) {
        case Method::Step:
            return ol::Step;
        case Method::Staggered:
            return ol::LinearStaggered;
        case Method::Trilinear:
            return ol::Trilinear;
        case Method::Cubic:
            return ol::Cubic;
        case Method::Tetrahedral:
            break;
    }
    throw UsageError("--mode tetrahedral does not go with --strict");
}

ColourWay wayThrough(const boost::shared_ptr<const ol::LUT>& table, const ColourOptions& options,
                     bool isStrict) {
    if (!isStrict) {
        return [evaluator = options.evaluator(table)](float* rgb, std::size_t colourCount) {
            evaluator.apply(rgb, rgb, colourCount);
        };
    }
    return [table, mode = options.bookMode(), extrapolates = options.extrapolates](
               float* rgb, std::size_t colourCount) {
        for (float* const end = rgb + 3 * colourCount; rgb != end; rgb += 3)
            table->interpolate(ol::RGB(rgb), mode, extrapolates).copy_out(rgb);
    };
}

void addColourOptions(CLI::App& command, ColourOptions& options) {
    std::vector<std::string> names;
    for (const auto& [name, method] : kMethods)
        names.emplace_back(name);
    command
        .add_option_function<std::string>(
            "--mode",
            [&options](const std::string& word) {
                for (const auto& [name, method] : kMethods) {
                    if (word == name) options.method = method;
                }
            },
            "Interpolation of a lattice (trilinear)")
        ->transform(CLI::IsMember(names, CLI::ignore_case))
        ->type_name("METHOD");
    command.add_flag("--extrapolate", options.extrapolates,
                     "Continue a lattice beyond its domain in straight lines; else clamp to it");
}

}  // namespace orlith
