#include "python/Pattern.h"

#include <string>

#include "python/Arrays.h"
#include "python/Tables.h"
#include "zefra/PatternLayout.h"

namespace python {
namespace {

namespace py = pybind11;
using Layout = zefra::PatternLayout;

constexpr int kSmallest = 2;
constexpr int kLargest = 129;

/// The line of an image, counted from the top, that a row of the pattern, counted from the bottom,
/// is in.
py::ssize_t lineOf(py::ssize_t row, py::ssize_t height) {
    return height - 1 - row;
}

/// The points of the pattern that has this size; 0 for none. A few pixels more at the top and at
/// the right do no harm.
int pointsOf(py::ssize_t width, py::ssize_t height) {
    const py::ssize_t widest = Layout::columns(kLargest) * py::ssize_t{Layout::kPatchPixels};
    if (width > widest + Layout::kPatchPixels) return 0;
    const int columns = static_cast<int>(width / Layout::kPatchPixels);
    const int points = Layout::points(columns);
    const bool fits = points >= kSmallest && points <= kLargest &&
                      Layout::columns(points) == columns &&
                      Layout::rows(points) == height / Layout::kPatchPixels;
    return fits ? points : 0;
}

/// Fills the pixels of a row of the pattern.
void fillRow(py::ssize_t size, py::ssize_t row, py::ssize_t width, float* pixels) {
    const py::ssize_t columns = width / Layout::kPatchPixels;
    for (py::ssize_t x = 0; x < width; ++x) {
        const py::ssize_t patch = row / Layout::kPatchPixels * columns + x / Layout::kPatchPixels;
        const bool isPadding = patch >= size * size * size;
        const py::ssize_t points[] = {patch % size, patch / size % size, patch / size / size};
        for (const py::ssize_t point : points) {
            *pixels++ = isPadding ? 0.0F : static_cast<float>(point) / static_cast<float>(size - 1);
        }
    }
}

}  // namespace

py::array makePattern(int size) {
    if (size < kSmallest || size > kLargest) {
        throw py::value_error("a pattern has 2 to 129 points a side, not " + std::to_string(size));
    }
    const py::ssize_t width = py::ssize_t{Layout::columns(size)} * Layout::kPatchPixels;
    const py::ssize_t height = py::ssize_t{Layout::rows(size)} * Layout::kPatchPixels;
    py::array_t<float> image({height, width, py::ssize_t{3}});
    float* const pixels = image.mutable_data();
    {
        const py::gil_scoped_release others;
        for (py::ssize_t row = 0; row < height; ++row)
            fillRow(size, row, width, pixels + 3 * width * lineOf(row, height));
    }
    return image;
}

Table tableOfPattern(const py::object& image) {
    const py::array given = toNumbers(image, "pixels");
    if (given.ndim() != 3 || given.shape(2) < 3) {
        throw py::value_error("a pattern is an image of shape (height, width, 3), not " +
                              shapeText(given));
    }
    const int points = pointsOf(given.shape(1), given.shape(0));
    if (points == 0) {
        throw py::value_error("no pattern has " + std::to_string(given.shape(1)) + " x " +
                              std::to_string(given.shape(0)) + " pixels");
    }
    const Floats pixels(given);
    const auto pixel = pixels.unchecked<3>();
    Table table = makeTable({points, points, points}, py::none());
    float* const samples = table.lut->data();
    const int columns = Layout::columns(points);
    const py::ssize_t patchCount = py::ssize_t{points} * points * points;
    for (py::ssize_t index = 0; index < patchCount; ++index) {
        const py::ssize_t row = index / columns * Layout::kPatchPixels + Layout::kPatchCentre;
        const py::ssize_t x = index % columns * Layout::kPatchPixels + Layout::kPatchCentre;
        const py::ssize_t line = lineOf(row, given.shape(0));
        for (py::ssize_t c = 0; c < 3; ++c)
            samples[3 * index + c] = pixel(line, x, c);
    }
    return table;
}

}  // namespace python
