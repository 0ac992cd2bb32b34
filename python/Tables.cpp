#include "python/Tables.h"

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <limits>
#include <map>
#include <stdexcept>
#include <vector>

#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "lut/evaluation/Look.h"
#include "lut/io/interchange/ChannelShaper.h"
#include "python/Text.h"

namespace python {
namespace {

namespace py = pybind11;
namespace ol = Orlith::LUT;

ol::Range toRange(const py::object& domain) {
    if (domain.is_none()) return ol::unitRange();
    const auto numpy = py::module_::import("numpy");
    py::array limits = numpy.attr("asarray")(domain, "float32");
    if (limits.ndim() == 1) {
        limits = limits.attr("reshape")(py::make_tuple(-1, 1));
    }
    const Floats floats(numpy.attr("broadcast_to")(limits, py::make_tuple(2, 3)));
    const ol::Range range{ol::RGB(floats.data()), ol::RGB(floats.data() + 3)};
    if (!ol::rises(range)) {
        throw py::value_error("the domain has to rise from finite to finite numbers");
    }
    return range;
}

py::array toColumns(const std::vector<float>& left, const std::vector<float>& right) {
    py::array_t<float> columns({static_cast<py::ssize_t>(left.size()), py::ssize_t{2}});
    auto cells = columns.mutable_unchecked<2>();
    for (std::size_t i = 0; i < left.size(); ++i) {
        cells(static_cast<py::ssize_t>(i), 0) = left[i];
        cells(static_cast<py::ssize_t>(i), 1) = right[i];
    }
    return columns;
}

template <class Value>
Value expect(const char* name, const char* type, const py::object& given) {
    py::detail::make_caster<Value> caster;
    if (!caster.load(given, true)) {
        throw py::type_error(std::string(name) + " has to be " + type + ", not " +
                             std::string(py::str(given.get_type().attr("__name__"))));
    }
    return py::detail::cast_op<Value>(caster);
}

void expectColours(const py::array& colours) {
    if (colours.ndim() > 0 && colours.shape(colours.ndim() - 1) == 3) return;
    throw py::value_error("the last axis of colours has to be 3 (red, green, blue), not shape " +
                          shapeText(colours));
}

}  // namespace

Table makeTable(const Shape& sides, const py::object& domain) {
    const ol::Range range = toRange(domain);
    constexpr py::ssize_t kMost = std::numeric_limits<int>::max();
    for (const py::ssize_t side : sides) {
        if (side < 2) throw py::value_error("a table needs two points or more on each side");
        if (side > kMost) throw py::value_error("a table has fewer points than that on a side");
    }
    const auto points = [&](std::size_t axis) {
        return static_cast<int>(sides.size() == 1 ? sides[0] : sides[axis]);
    };
    Table table;
    try {
        if (sides.size() == 1) {
            table.lut = boost::make_shared<ol::LUT1D>();
            table.lut->resize(points(0));
        } else {
            table.lut = boost::make_shared<ol::LUT3D>();
            table.lut->resize(points(0), points(1), points(2));
        }
    } catch (const std::length_error&) {
        throw py::value_error("a table has fewer points than that");
    }
    ol::setDomain(*table.lut, range, {points(0), points(1), points(2)});
    return table;
}

Table tableOfSamples(const py::object& samples, const py::object& domain) {
    const py::array given = toNumbers(samples, "samples");
    Shape sides = shapeOf(given);
    if ((sides.size() != 2 && sides.size() != 4) || sides.back() != 3) {
        throw py::value_error("samples have to be of shape (N, 3) or (R, G, B, 3), not " +
                              shapeText(given));
    }
    sides.pop_back();
    Table table = makeTable(sides, domain);
    samplesOf(table, py::none())[py::ellipsis()] = given;
    return table;
}

Table tableOfFunction(const py::function& function, int size, const py::object& domain,
                      const std::string& kind) {
    if (kind != "1D" && kind != "3D") {
        throw py::value_error("kind has to be \"1D\" or \"3D\", not \"" + kind + "\"");
    }
    Table table = makeTable(Shape(kind == "1D" ? 1 : 3, size), domain);
    // The inputs first, in the samples' own places.
    float* next = table.lut->data();
    ol::forEachInput(*table.lut, false, [&](const ol::RGB& colour) {
        next = std::copy_n(colour.data_block(), 3, next);
    });
    const py::array samples = samplesOf(table, py::none());
    const py::array result = toNumbers(function(samples.attr("copy")()), "the function's colours");
    if (shapeOf(result) != shapeOf(samples)) {
        throw py::value_error("the function was given colours of shape " + shapeText(samples) +
                              " and gave " + shapeText(result));
    }
    samples[py::ellipsis()] = result;
    return table;
}

py::array samplesOf(const Table& table, const py::object& owner) {
    const ol::LUT& lut = *table.lut;
    constexpr py::ssize_t kFloat = sizeof(float);
    constexpr py::ssize_t kSample = 3 * kFloat;
    const py::ssize_t width = lut.width();
    if (lut.is1D()) {
        return py::array_t<float>({width, py::ssize_t{3}}, {kSample, kFloat}, lut.data(), owner);
    }
    const py::ssize_t height = lut.height();
    const py::ssize_t depth = lut.depth();
    return py::array_t<float>({width, height, depth, py::ssize_t{3}},
                              {kSample, kSample * width, kSample * width * height, kFloat},
                              lut.data(), owner);
}

std::string kindOf(const Table& table) {
    return table.lut->is1D() ? "1D" : "3D";
}

py::tuple sizeOf(const Table& table) {
    const ol::LUT& lut = *table.lut;
    return lut.is1D() ? py::make_tuple(lut.width())
                      : py::make_tuple(lut.width(), lut.height(), lut.depth());
}

py::array domainOf(const Table& table) {
    const ol::Range range = ol::inputRangeOf(*table.lut);
    py::array_t<float> domain({2, 3});
    range.max.copy_out(std::copy_n(range.min.data_block(), 3, domain.mutable_data()));
    return domain;
}

py::object shaperOf(const Table& table) {
    if (table.lut->inputShaper.empty() && table.lut->outputShaper.empty()) return py::none();
    py::tuple channels(3);
    for (unsigned c = 0; c < 3; ++c) {
        const ol::ChannelShaper shaper = ol::shaperOf(*table.lut, c);
        channels[c] = toColumns(shaper.inputs, shaper.outputs);
    }
    return channels;
}

py::list remarksOf(const Table& table) {
    py::list list;
    for (const ol::Remark& remark : table.remarks)
        list.append(py::make_tuple(toLine(remark.line), toText(remark.text)));
    return list;
}

ol::Evaluator::Method toMethod(const py::object& given) {
    using Method = ol::Evaluator::Method;
    static const std::map<std::string, Method> methods = {{"step", Method::Step},
                                                          {"staggered", Method::Staggered},
                                                          {"trilinear", Method::Trilinear},
                                                          {"tetrahedral", Method::Tetrahedral},
                                                          {"cubic", Method::Cubic}};
    const auto mode = expect<std::string>("mode", "a str", given);
    const auto found = methods.find(mode);
    if (found == methods.end()) {
        throw py::value_error(
            "mode has to be \"step\", \"staggered\", \"trilinear\", \"tetrahedral\" or \"cubic\","
            " not \"" +
            mode + "\"");
    }
    return found->second;
}

ol::Evaluator::Outside toOutside(const py::object& extrapolate) {
    return expect<bool>("extrapolate", "a bool", extrapolate) ? ol::Evaluator::Outside::Extrapolate
                                                              : ol::Evaluator::Outside::Clamp;
}

py::object evaluate(const Table& table, const py::object& colours, const py::object& mode,
                    const py::object& extrapolate) {
    const py::array given = toNumbers(colours, "colours");
    expectColours(given);
    // Made anew each time: samples may be written to between calls.
    const ol::Evaluator evaluator(table.lut, toMethod(mode), toOutside(extrapolate));
    const Floats in(given);
    py::array_t<float> out(shapeOf(given));
    const float* const from = in.data();
    float* const to = out.mutable_data();
    {
        const py::gil_scoped_release others;
        evaluator.apply(from, to, static_cast<std::size_t>(in.size()) / 3);
    }
    if (given.itemsize() == sizeof(float)) return out;
    return out.attr("astype")(given.itemsize() < py::ssize_t{sizeof(float)} ? "float16"
                                                                            : "float64");
}

}  // namespace python
