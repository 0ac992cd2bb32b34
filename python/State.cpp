#include "python/State.h"

#include <pybind11/numpy.h>
#include <pybind11/stl.h>

#include <algorithm>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "python/Arrays.h"

namespace python {
namespace {

namespace py = pybind11;
namespace ol = Orlith::LUT;

/// Samples, the domain's steps and first inputs, two shapers, remarks.
constexpr std::size_t kParts = 5;

[[noreturn]] void refuse() {
    throw py::value_error("this is no state of a Table");
}

py::array toRows(const std::vector<ol::RGB>& colours) {
    py::array_t<float> rows({static_cast<py::ssize_t>(colours.size()), py::ssize_t{3}});
    float* next = rows.mutable_data();
    for (const ol::RGB& colour : colours)
        next = std::copy_n(colour.data_block(), 3, next);
    return rows;
}

std::vector<ol::RGB> toColours(const py::handle& rows) {
    const Floats floats(py::reinterpret_borrow<py::object>(rows));
    if (floats.ndim() != 2 || floats.shape(1) != 3) refuse();
    std::vector<ol::RGB> colours;
    for (py::ssize_t i = 0; i < floats.shape(0); ++i)
        colours.emplace_back(floats.data(i));
    return colours;
}

py::tuple stateOf(const ol::Shaper& shaper) {
    return py::make_tuple(toRows({shaper.counts}), toRows(shaper.entries));
}

ol::Shaper toShaper(const py::handle& state) {
    const auto [counts, entries] = state.cast<std::pair<py::object, py::object>>();
    const std::vector<ol::RGB> triple = toColours(counts);
    if (triple.size() != 1) refuse();
    return {toColours(entries), triple.front()};
}

}  // namespace

py::tuple stateOf(const Table& table) {
    const ol::LUT& lut = *table.lut;
    ol::RGB scale;
    ol::RGB offset;
    for (unsigned c = 0; c < 3; ++c) {
        scale[c] = lut.transform[c][c];
        offset[c] = lut.transform[3][c];
    }
    py::list remarks;
    // Bytes: a file may say anything.
    for (const ol::Remark& remark : table.remarks)
        remarks.append(py::make_tuple(remark.line, py::bytes(remark.text)));
    return py::make_tuple(samplesOf(table, py::none()).attr("copy")("K"), toRows({scale, offset}),
                          stateOf(lut.inputShaper), stateOf(lut.outputShaper), remarks);
}

Table tableOfState(const py::tuple& state) {
    if (state.size() != kParts) refuse();
    const py::array samples = toNumbers(state[0], "samples");
    Shape sides = shapeOf(samples);
    if ((sides.size() != 2 && sides.size() != 4) || sides.back() != 3) refuse();
    sides.pop_back();
    Table table = emptyTable(sides);
    samplesOf(table, py::none())[py::ellipsis()] = samples;
    const std::vector<ol::RGB> domain = toColours(state[1]);
    if (domain.size() != 2) refuse();
    for (unsigned c = 0; c < 3; ++c) {
        table.lut->transform[c][c] = domain[0][c];
        table.lut->transform[3][c] = domain[1][c];
    }
    table.lut->inputShaper = toShaper(state[2]);
    table.lut->outputShaper = toShaper(state[3]);
    for (auto& [line, text] : state[4].cast<std::vector<std::pair<std::uint64_t, std::string>>>())
        table.remarks.push_back({line, std::move(text)});
    return table;
}

}  // namespace python
