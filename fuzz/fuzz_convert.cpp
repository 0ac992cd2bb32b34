// Reads bytes as a file of any format, writes the table in every format, and reads that again: each
// writer either refuses the table or writes a file that its reader takes, with the same samples as
// far as the format keeps them.

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <stdexcept>
#include <string>

#include "fuzz/Input.h"
#include "fuzz/ReaderOptions.h"
#include "lut/Exception.h"
#include "lut/io/Lattice.h"
#include "lut/io/Registry.h"

namespace {

namespace ol = Orlith::LUT;
namespace property = Orlith::Property;

constexpr const char* kFormats[] = {".cube", ".3dl", ".cms",  ".csp",
                                    ".cub",  ".vf",  ".blut", ".vfz"};
constexpr std::size_t kWritableFormats = 7;  // the last is read only in its own right
constexpr std::size_t kMostPoints = 4096;

std::size_t pointCount(const ol::LUT& lut) {
    return lut.is1D() ? static_cast<std::size_t>(lut.width())
                      : ol::LatticeSize::of(lut).pointCount();
}

bool isFinite(const ol::LUT& lut) {
    const float* const samples = lut.data();
    return std::all_of(samples, samples + 3 * pointCount(lut),
                       [](float sample) { return std::isfinite(sample); });
}

bool isNear(float a, float b) {
    if (a == b || (std::isnan(a) && std::isnan(b))) return true;
    const auto read = static_cast<double>(a);
    const auto written = static_cast<double>(b);
    return std::fabs(read - written) <= 0.5e-6 + 1.2e-7 * std::fabs(written);
}

void check(bool isRight, const std::string& extension, const char* what) {
    if (isRight) return;
    std::fprintf(stderr, "%s: %s\n", extension.c_str(), what);
    std::abort();
}

void setWriterOptions(ol::LUTFileWriter& writer, fuzz::Mode mode) {
    const auto set = [&](const char* name, auto value) { writer.setProperty(name, value); };
    set("interchange", fuzz::interchange(mode));
    set("inputBitDepth", property::makeProperty<property::Int>("inputBitDepth", 10));
    set("outputBitDepth", property::makeProperty<property::Int>("outputBitDepth", 12));
    set("clampOutput", property::makeProperty<property::Int>("clampOutput", 0));
    set("format3DL", property::makeProperty<property::String>("format3DL", "flame"));
    set("flushLines", property::makeProperty<property::Int>("flushLines", 0));
}

/// What a writer takes, its reader has to take: but for what the formats are known not to hold.
bool readsBack(const std::string& extension, const ol::LUT& lut) {
    if (extension == ".cms") return lut.width() >= 2;
    return extension != ".blut" || lut.width() <= 127;
}

void writeAndRead(const boost::shared_ptr<ol::LUT>& lut, const std::string& extension,
                  const fuzz::MemoryFile& file, fuzz::Mode mode) {
    const auto writer = ol::createWriter("", true, extension);
    setWriterOptions(*writer, mode);
    try {
        writer->write(file.path(), lut);
    } catch (const ol::Exception&) {
        return;
    }
    if (!readsBack(extension, *lut)) return;
    const auto reader = ol::createReader("", true, extension);
    fuzz::setReaderOptions(*reader, 0, 0, mode);
    boost::shared_ptr<ol::LUT> back;
    try {
        back = reader->read(file.path());
    } catch (const ol::Exception& exception) {
        check(false, extension, exception.message());
    }
    check(back->is1D() == lut->is1D() && pointCount(*back) == pointCount(*lut), extension, "size");
    if (extension == ".3dl") return;
    for (std::size_t i = 0; i < 3 * pointCount(*lut); ++i) {
        check(isNear(back->data()[i], lut->data()[i]), extension, "samples differ");
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t byteCount) {
    static fuzz::MemoryFile input;
    static fuzz::MemoryFile output;
    if (byteCount == 0) return 0;
    const std::size_t format = bytes[byteCount - 1] % (kWritableFormats + 1);
    const auto reader = ol::createReader("", true, kFormats[format]);
    const fuzz::Mode mode = fuzz::modeOf(bytes[byteCount - 1] / 8);
    fuzz::setReaderOptions(*reader, bytes[byteCount - 1], 0, mode);
    input.hold(bytes, byteCount);
    boost::shared_ptr<ol::LUT> lut;
    try {
        lut = reader->read(input.path());
    } catch (const ol::Exception&) {
        return 0;
    } catch (const std::length_error&) {
        return 0;
    } catch (const std::bad_alloc&) {
        return 0;
    }
    if (pointCount(*lut) == 0 || pointCount(*lut) > kMostPoints) return 0;
    // As meant, a text with an infinite sample is no table.
    if (mode == fuzz::Mode::Meant && !isFinite(*lut)) return 0;
    for (std::size_t i = 0; i < kWritableFormats; ++i)
        writeAndRead(lut, kFormats[i], output, mode);
    return 0;
}
