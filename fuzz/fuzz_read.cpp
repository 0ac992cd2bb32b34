// Reads any bytes as a file of one format. A table, an Exception or the standard library's length
// error are fine, everything else is a finding. What was read is evaluated as well.

#include <limits>
#include <stdexcept>

#include "fuzz/Input.h"
#include "fuzz/ReaderOptions.h"
#include "lut/Evaluator.h"
#include "lut/Exception.h"
#include "lut/io/Registry.h"

namespace {

namespace ol = Orlith::LUT;

void evaluate(const boost::shared_ptr<ol::LUT>& lut) {
    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    const ol::RGB points[] = {{0.3F, 0.6F, 0.9F},
                              {-1.0F, 2.0F, 1e30F},
                              {kInfinity, -kInfinity, std::numeric_limits<float>::quiet_NaN()}};
    for (const ol::RGB& point : points) {
        for (const auto mode : {ol::Step, ol::LinearStaggered, ol::Trilinear, ol::Cubic}) {
            lut->interpolate(point, mode, false);
            lut->interpolate(point, mode, true);
        }
        ol::RGB out;
        ol::Evaluator(lut).apply(point.data_block(), out.data_block(), 1);
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t byteCount) {
    static fuzz::MemoryFile file;
    file.hold(bytes, byteCount);
    for (const auto mode : {fuzz::Mode::Book, fuzz::Mode::Meant}) {
        const auto reader = ol::createReader("", true, ORLITH_FUZZ_EXTENSION);
        // The last bytes choose the options, so that samples are valid inputs as they are.
        fuzz::setReaderOptions(*reader, byteCount > 0 ? bytes[byteCount - 1] : 0,
                               byteCount > 1 ? bytes[byteCount - 2] : 0, mode);
        try {
            evaluate(reader->read(file.path()));
        } catch (const ol::Exception&) {
        } catch (const std::length_error&) {
        } catch (const std::bad_alloc&) {  // a claim beyond the address space that the run may have
        }
        reader->remarks();
    }
    return 0;
}
