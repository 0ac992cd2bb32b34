#include "lut/io/table/Options3DL.h"

#include <algorithm>
#include <cmath>

namespace Orlith::LUT {
namespace {

namespace property = Orlith::Property;

// As the operator has them: 97/99 in single precision, and the code of Scratch's black.
constexpr double kScratchScale = 0.9797979593276978;
constexpr double kScratchOffset = 15.0;

}  // namespace

double ownScale(const std::string& dialect) {
    return dialect == "scratch" ? kScratchScale : 1.0;
}

double ownOffset(const std::string& dialect) {
    return dialect == "scratch" ? kScratchOffset : 0.0;
}

void setWriterProperties(LUTFileWriter& writer, const Options3DL& options) {
    const auto set = [&](const char* name, auto property) { writer.setProperty(name, property); };
    set("inputBitDepth", property::makeProperty<property::Int>("inputBitDepth", options.inputBits));
    set("outputBitDepth",
        property::makeProperty<property::Int>("outputBitDepth", options.outputBits));
    set("clampOutput",
        property::makeProperty<property::Int>("clampOutput", options.clampOutput ? 1 : 0));
    set("format3DL", property::makeProperty<property::String>("format3DL", options.dialect));
    set("scale",
        property::makeProperty<property::Double>("scale", static_cast<double>(options.scale)));
    set("offset",
        property::makeProperty<property::Double>("offset", static_cast<double>(options.offset)));
}

double codeOf(double value, const Options3DL& options) {
    const double codeMax = std::ldexp(1.0, options.outputBits) - 1.0;
    double code =
        value * codeMax * static_cast<double>(options.scale) + static_cast<double>(options.offset);
    if (std::isnan(code)) code = 0.0;
    code = std::clamp(code, -2147483648.0, 2147483647.0);
    return options.clampOutput ? std::clamp(code, 0.0, codeMax) : code;
}

}  // namespace Orlith::LUT
