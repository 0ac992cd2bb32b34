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

/// The domain's steps and first inputs, two shapers, remarks.
constexpr std::size_t kParts = 4;

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

py::tuple partsOf(const py::object& table) {
    const auto& given = table.cast<const Table&>();
    const ol::LUT& lut = *given.lut;
    ol::RGB step;
    ol::RGB first;
    for (unsigned c = 0; c < 3; ++c) {
        step[c] = lut.transform[c][c];
        first[c] = lut.transform[3][c];
    }
    py::list remarks;
    // Bytes: a file may say anything.
    for (const ol::Remark& remark : given.remarks)
        remarks.append(py::make_tuple(remark.line, py::bytes(remark.text)));
    const py::tuple state = py::make_tuple(toRows({step, first}), stateOf(lut.inputShaper),
                                           stateOf(lut.outputShaper), remarks);
    return py::make_tuple(
        py::module_::import("orlith").attr("_restored"),
        py::make_tuple(table.get_type(), table.attr("samples").attr("copy")("K"), state));
}

void restore(Table& table, const py::tuple& state) {
    if (state.size() != kParts) refuse();
    const std::vector<ol::RGB> domain = toColours(state[0]);
    if (domain.size() != 2) refuse();
    ol::Shaper inputShaper = toShaper(state[1]);
    ol::Shaper outputShaper = toShaper(state[2]);
    auto remarks = state[3].cast<std::vector<std::pair<std::uint64_t, std::string>>>();

    for (unsigned c = 0; c < 3; ++c) {
        table.lut->transform[c][c] = domain[0][c];
        table.lut->transform[3][c] = domain[1][c];
    }
    table.lut->inputShaper = std::move(inputShaper);
    table.lut->outputShaper = std::move(outputShaper);
    table.remarks.clear();
    for (auto& [line, text] : remarks)
        table.remarks.push_back({line, std::move(text)});
}

}  // namespace python
