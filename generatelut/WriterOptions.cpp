#include "generatelut/WriterOptions.h"

#include <algorithm>
#include <string>

#include "generatelut/Menus.h"

namespace generatelut {
namespace {

namespace property = Orlith::Property;

// Scratch keeps headroom at both ends: code c becomes c * 97/99 + 15. The scale is 97/99 in single
// precision, widened.
constexpr double kScratchScale = 0.9797979593276978;
constexpr double kScratchOffset = 15.0;

/// Bits of an entry of the bit-depth menus; an index that is not on them gives the nearest entry.
int bitsOf(int index) {
    constexpr int kBits[] = {4, 8, 10, 12, 16};
    return kBits[std::clamp(index, 0, 4)];
}

/// The writer's word for an entry of the format menu. Index 3, which only the script of an old node
/// can set, and everything beyond is "auto", which the writer refuses.
const char* formatName(int index) {
    constexpr const char* kNames[] = {"auto", "flame", "lustre", "scratch"};
    return index >= 0 && index < 3 ? kNames[index + 1] : kNames[0];
}

template <class Kind, class Value>
void set(Orlith::LUT::LUTFileWriter& writer, const char* name, const Value& value) {
    writer.setProperty(name, property::makeProperty<Kind>(name, value));
}

}  // namespace

void setWriterOptions(Orlith::LUT::LUTFileWriter& writer, const Options3DL& options) {
    const int inputBits = bitsOf(options.bitDepth);
    // The output menu begins with "input bit depth". Limited before it is counted down: the
    // smallest integer has none below it.
    const int outputBits =
        options.outputBitDepth == 0 ? inputBits : bitsOf(std::max(options.outputBitDepth, 1) - 1);
    set<property::Int>(writer, "inputBitDepth", inputBits);
    set<property::Int>(writer, "outputBitDepth", outputBits);
    set<property::Int>(writer, "clampOutput", options.clampOutput ? 1 : 0);
    set<property::String>(writer, "format3DL", formatName(options.format));
    if (options.format == kScratchFormat) {
        set<property::Double>(writer, "scale", kScratchScale);
        set<property::Double>(writer, "offset", kScratchOffset);
    }
}

}  // namespace generatelut
