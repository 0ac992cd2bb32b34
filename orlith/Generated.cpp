#include "orlith/Generated.h"

#include "orlith/TableFile.h"
#include "orlith/Verification.h"
#include "orlith/WriteOptions.h"

namespace orlith {
namespace {

/// The options that a .3dl file was written with, from the operator's controls.
Options3DL options3DLOf(host::Node& node) {
    // They show while .3dl is the file type; hidden ones keep their values.
    node.setValue("file_type", ".3dl");
    const auto index = [&](const char* name) {
        return static_cast<std::size_t>(node.findControl(name)->number());
    };
    constexpr int kBits[] = {4, 8, 10, 12, 16};
    constexpr const char* kDialects[] = {"flame", "lustre", "scratch"};
    WriteOptions options;
    options.bitDepth = kBits[index("bitdepth_id")];
    if (const std::size_t output = index("output_bitdepth_id"); output > 0) {
        options.outputBitDepth = kBits[output - 1];
    }
    options.clampOutput = index("clamp_output") != 0;
    options.format3DL = kDialects[index("format_3dl_id")];
    return options.options3DL();
}

/// The pre-LUT that the operator gives to a table.
void addPreLUT(Orlith::LUT::LUT& lut, const host::Node& node) {
    const host::PanelControl* const entryCount = node.findControl("lut1d");
    if (!entryCount->hasValue()) return;  // no pre-LUT in a .3dl file
    setPreLUT(lut, entryCount->number(), node.value("style1d"));
}

}  // namespace

std::string formatWritten(const host::Node& node, const std::string& name) {
    const std::string type = node.value("file_type");
    return formatOf(name, type.find('.') == std::string::npos ? "" : type);
}

std::string reportGenerated(host::Node& node, Orlith::LUT::LUT3D& table, const Generated& file) {
    const std::string extension = formatWritten(node, file.name);
    addPreLUT(table, node);
    Verification verification;
    verification.reason = file.whyNotReadBack;
    if (verification.reason.empty()) {
        const Options3DL options3DL = extension == ".3dl" ? options3DLOf(node) : Options3DL();
        verification = verify(file.path, file.name, extension, table, options3DL);
    }
    return summary(file.name, extension, table, verification);
}

}  // namespace orlith
