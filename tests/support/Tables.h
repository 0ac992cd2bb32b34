#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "tests/support/ThreeDL.h"

namespace test {

namespace ol = Orlith::LUT;

/// A lattice whose every float tells its place and channel, (r + 10 g + 100 b + 1000 c) / divisor,
/// so that no swapped axis, transposed loop or exchanged channel goes unseen.
boost::shared_ptr<ol::LUT3D> markedLattice(int width, int height, int depth,
                                           float divisor = 10000.0F);

/// A curve of the same kind: (i + 1000 c) / 10000.
boost::shared_ptr<ol::LUT1D> markedCurve(int sampleCount);

/// What markedLattice holds at a point.
ol::RGB markedSample(int r, int g, int b, float divisor = 10000.0F);

/// Expects the floats of a triple, bit for bit.
void expectRGB(const ol::RGB& actual, float r, float g, float b);
void expectRGB(const ol::RGB& actual, const ol::RGB& expected);

/// Expects every sample of two tables of the same kind and size to agree within a tolerance.
void expectSamplesNear(const ol::LUT& actual, const ol::LUT& expected, float tolerance);

/// The message of the Exception that an action throws; "(no exception)" if it throws none.
std::string messageOf(const std::function<void()>& action);

/// Reads bytes with the reader of an extension; formats other than .3dl do not look at its options.
boost::shared_ptr<ol::LUT> readBytes(const std::string& extension, std::string_view bytes,
                                     const Reading3DL& reading = {});

}  // namespace test
