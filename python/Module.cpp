// The Python module: what Python sees.

#include <pybind11/pybind11.h>
#include <pybind11/stl.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "lut/evaluation/Look.h"
#include "lut/io/table/FileFormat.h"
#include "python/Arrays.h"
#include "python/Documentation.h"
#include "python/Errors.h"
#include "python/Files.h"
#include "python/Pattern.h"
#include "python/State.h"
#include "python/Tables.h"
#include "python/Text.h"

namespace python {
namespace {

namespace py = pybind11;
namespace ol = Orlith::LUT;

template <class Value>
void expectOneOf(const char* name, const Value& value, const std::vector<Value>& values) {
    if (std::find(values.begin(), values.end(), value) != values.end()) return;
    throw py::value_error(std::string(name) + " has to be one of " +
                          std::string(py::str(py::cast(values))) + ", not " +
                          std::string(py::repr(py::cast(value))));
}

int toBits(const std::variant<int, std::string>& given) {
    if (const int* const bits = std::get_if<int>(&given)) {
        if (*bits >= 1 && *bits <= 31) return *bits;
    } else if (std::get<std::string>(given) == "detect") {
        return ol::ReadOptions::kDetect;
    } else if (std::get<std::string>(given) == "input") {
        return ol::ReadOptions::kAsInput;
    }
    throw py::value_error("output_bit_depth has to be \"detect\", \"input\" or 1 to 31");
}

Table read(const py::object& path, bool isStrict, const std::optional<std::string>& format,
           const std::string& format3DL, const std::variant<int, std::string>& outputBitDepth,
           bool normalizeOutput) {
    expectOneOf<std::string>("format_3dl", format3DL, {"auto", "flame", "lustre", "scratch"});
    const ol::ReadOptions options{ol::withDot(format.value_or("")), isStrict, format3DL,
                                  toBits(outputBitDepth), normalizeOutput};
    const std::string file = toPath(path);
    const py::gil_scoped_release others;
    return readFile(file, options);
}

/// Tells Python of losses, which its user may have made an error.
void warnOf(const std::string& path, const std::vector<std::string>& losses) {
    const py::gil_scoped_acquire hold;
    const std::string place = path + ": ";
    for (const std::string& loss : losses) {
        const py::object text = toText(place + loss);
        if (PyErr_WarnEx(PyExc_UserWarning, PyUnicode_AsUTF8(text.ptr()), 1) != 0) {
            throw py::error_already_set();
        }
    }
}

/// A factor or a summand of codes, in the writer's precision.
float toSingle(const char* name, double number) {
    if (!(std::fabs(number) <= static_cast<double>(std::numeric_limits<float>::max()))) {
        throw py::value_error(std::string(name) + " has to be a finite number");
    }
    return static_cast<float>(number);
}

Written write(const Table& table, const py::object& path, const std::optional<std::string>& format,
              std::optional<int> size, int bitDepth, std::optional<int> outputBitDepth,
              bool clampOutput, const std::string& format3DL, std::optional<double> scale,
              std::optional<double> offset) {
    const std::vector<int> depths = {4, 8, 10, 12, 16};
    expectOneOf("bit_depth", bitDepth, depths);
    expectOneOf("output_bit_depth", outputBitDepth.value_or(bitDepth), depths);
    expectOneOf<std::string>("format_3dl", format3DL, {"flame", "lustre", "scratch"});
    if (size && (*size < 2 || *size > 256)) throw py::value_error("size has to be 2 to 256");
    WriteOptions options;
    options.to = ol::withDot(format.value_or(""));
    options.size = size.value_or(0);
    options.options3DL = {bitDepth,
                          outputBitDepth.value_or(bitDepth),
                          clampOutput,
                          format3DL,
                          toSingle("scale", scale.value_or(ol::ownScale(format3DL))),
                          toSingle("offset", offset.value_or(ol::ownOffset(format3DL)))};
    const std::string file = toPath(path);
    const py::gil_scoped_release others;
    return writeFile(table, file, options, [&](const auto& losses) { warnOf(file, losses); });
}

/// A table as it is, or that of a path.
boost::shared_ptr<const ol::LUT> toLUT(const py::object& given) {
    if (py::isinstance<Table>(given)) return given.cast<const Table&>().lut;
    const std::string file = toPath(given);
    const py::gil_scoped_release others;
    return readFile(file, {}).lut;
}

struct Difference {
    ol::Differences channels;
};

Difference diff(const py::object& a, const py::object& b, const py::object& mode,
                const py::object& extrapolate) {
    const auto method = toMethod(mode);
    const auto outside = toOutside(extrapolate);
    const auto lutA = toLUT(a);
    const auto lutB = toLUT(b);
    const auto lookOf = [&](const boost::shared_ptr<const ol::LUT>& lut) -> ol::ColourWay {
        return [evaluator = ol::Evaluator(lut, method, outside)](float* rgb, std::size_t count) {
            evaluator.apply(rgb, rgb, count);
        };
    };
    const py::gil_scoped_release others;
    return {ol::compareLooks(*lutA, lookOf(lutA), *lutB, lookOf(lutB))};
}

/// A number of each channel, (3,).
template <double ol::Difference::*kNumber>
py::array_t<double> each(const Difference& difference) {
    py::array_t<double> numbers(3);
    std::transform(difference.channels.begin(), difference.channels.end(), numbers.mutable_data(),
                   [](const ol::Difference& channel) { return channel.*kNumber; });
    return numbers;
}

py::array_t<float> places(const Difference& difference) {
    py::array_t<float> places({3, 3});
    float* next = places.mutable_data();
    for (const ol::Difference& channel : difference.channels)
        next = std::copy_n(channel.at.data_block(), 3, next);
    return places;
}

std::string describe(const Table& table) {
    return "<orlith.Table " + kindOf(table) + ", " + std::string(py::str(sizeOf(table))) + ">";
}

void defineTable(py::module_& module) {
    py::class_<Table> table(module, "Table", kTableText);
    table
        .def(py::init(&tableOfSamples), kInitText, py::arg("samples"),
             py::arg("domain") = py::none())
        .def_static("from_function", &tableOfFunction, kFromFunctionText, py::arg("f"),
                    py::arg("size") = 33, py::arg("domain") = py::none(), py::arg("kind") = "3D")
        .def("__call__", &evaluate, kCallText, py::arg("colours"), py::arg("mode") = "trilinear",
             py::arg("extrapolate") = false)
        .def("write", &write, kWriteText, py::arg("path"), py::kw_only(),
             py::arg("format") = py::none(), py::arg("size") = py::none(),
             py::arg("bit_depth") = 10, py::arg("output_bit_depth") = py::none(),
             py::arg("clamp_output") = true, py::arg("format_3dl") = "flame",
             py::arg("scale") = py::none(), py::arg("offset") = py::none())
        .def("__repr__", &describe)
        .def("__reduce__", &partsOf, "What copies and pickles are made of.")
        .def("_restore", &restore, py::arg("state"), "Takes what __reduce__ has beside samples.")
        .def_property_readonly("kind", &kindOf, "\"1D\": a curve; \"3D\": a lattice.")
        .def_property_readonly("size", &sizeOf,
                               "Points along red, green and blue; of a curve (N,).")
        .def_property_readonly(
            "domain", &domainOf,
            "float32 (2, 3): least and largest inputs of each channel. Behind a shaper, its own.")
        .def_property_readonly(
            "shaper", &shaperOf,
            "None, or a float32 array (n, 2) for each of red, green and blue: inputs, and the\n"
            "places in the table, from 0 to 1, that straight lines between them lead to.")
        .def_property_readonly(
            "samples", [](const py::object& self) { return samplesOf(self.cast<Table&>(), self); },
            "float32 [r, g, b, channel], of a curve [i, channel]: the table's own memory, red\n"
            "fastest, which lives as long as this array. What is written to it counts at once.")
        .def_property_readonly("remarks", &remarksOf,
                               "What the reader forgave or did not use: (line or None, text).");
    table.attr("__module__") = "orlith";
}

void defineResults(py::module_& module) {
    py::class_<Difference> difference(
        module, "Difference", "How far two looks are apart, for red, green and blue; see diff.");
    difference
        .def_property_readonly("largest", &each<&ol::Difference::largest>,
                               "float64 (3,); inf where only one of them is a number.")
        .def_property_readonly("at", &places,
                               "float32 (3, 3): the input where each channel's largest is.")
        .def_property_readonly("mean", &each<&ol::Difference::mean>, "float64 (3,)")
        .def_property_readonly("rms", &each<&ol::Difference::rootMeanSquare>,
                               "float64 (3,): the root of the mean square.")
        .def("__repr__", [](const py::object& self) {
            return py::str("<orlith.Difference, largest {}>").format(self.attr("largest"));
        });
    difference.attr("__module__") = "orlith";

    py::class_<Written> written(module, "Written", "What became of a table in its file.");
    written.def_readonly("format", &Written::format, "The format's extension, \".cube\".")
        .def_readonly("deviation", &Written::deviation,
                      "The largest distance between the file's look and the table's, within the\n"
                      "domain of both; None for a pipe or a device, which is not read back.")
        .def_readonly("resampled", &Written::whyResampled,
                      "Why the table could not go into the file as it is, \"a shaper\"; or \"\".")
        .def_readonly("losses", &Written::losses,
                      "What the format does not hold, in words; each was a UserWarning.")
        .def("__repr__", [](const py::object& self) {
            const py::object deviation = self.attr("deviation");
            if (deviation.is_none()) return py::str("<orlith.Written, not read back>");
            return py::str("<orlith.Written {}, largest deviation {:.2g}>")
                .format(self.attr("format"), deviation);
        });
    written.attr("__module__") = "orlith";
}

void defineFunctions(py::module_& module) {
    module.def("read", &read, kReadText, py::arg("path"), py::kw_only(), py::arg("strict") = false,
               py::arg("format") = py::none(), py::arg("format_3dl") = "auto",
               py::arg("output_bit_depth") = "detect", py::arg("normalize_output") = false);
    module.def(
        "convert",
        [module](const py::object& input, const py::object& output, const py::kwargs& options) {
            return module.attr("read")(input).attr("write")(output, **options);
        },
        kConvertText, py::arg("input"), py::arg("output"));
    module.def("diff", &diff, kDiffText, py::arg("a"), py::arg("b"), py::arg("mode") = "trilinear",
               py::arg("extrapolate") = false);
    module.def("pattern", &makePattern, kPatternText, py::arg("size") = 33);
    module.def("from_pattern", &tableOfPattern, kFromPatternText, py::arg("image"));
}

}  // namespace
}  // namespace python

PYBIND11_MODULE(_orlith, module) {
    pybind11::options texts;
    texts.disable_function_signatures();
    module.attr("__version__") = ORLITH_VERSION;
    python::defineError(module);
    python::defineTable(module);
    python::defineResults(module);
    python::defineFunctions(module);
}
