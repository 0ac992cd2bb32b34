#include "orlith/Generated.h"

#include <fmt/format.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>

#include "lut/LUT3D.h"
#include "lut/evaluation/Look.h"
#include "lut/io/Registry.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/table/TableFile.h"
#include "orlith/table/Verification.h"
#include "orlith/table/WriteOptions.h"

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

/// Warns where the operator's file does not have the pattern's look for those who read it: its
/// pre-LUT from 0 to 1 reaches the first cell only where a format wants lattice units.
void warnOfOtherLook(const Generated& file, const std::string& extension,
                     const Orlith::LUT::LUT3D& table) {
    if (extension != ".cub" && extension != ".cms") return;
    ReadOptions reading;
    reading.from = extension;
    const Table back = readTable(file.path, reading, file.name);
    const Orlith::LUT::Evaluator read(back.lut);
    // What the pattern stands for: its colours as they are, without the pre-LUT.
    const auto look = boost::make_shared<Orlith::LUT::LUT3D>();
    look->resize(table.width(), table.height(), table.depth());
    std::copy_n(table.data(), 3 * pointCount(table), look->data());
    Orlith::LUT::setUnitDomain(*look, look->width(), look->height(), look->depth());
    const Orlith::LUT::Evaluator meant(look);
    Orlith::LUT::LookComparison comparison(read, meant);
    forEachInput(*look, false, [&](const auto& colour) { comparison.add(colour); });
    const double deviation = largestOf(comparison.finish());
    constexpr double kFormatPrecision = 1e-5;
    if (!(deviation > kFormatPrecision)) return;
    std::string base;
    Orlith::LUT::splitExtension(file.name, &base, nullptr);
    const std::string cure =
        extension == ".cub"
            ? "--lut1d 0 leaves it away"
            : fmt::format("generate {0}.cube and make it by \"orlith convert {0}.cube {1}\"", base,
                          file.name);
    warn(fmt::format(
        "{}: programs that read {} files see a look that is off by {}: the operator's pre-LUT"
        " from 0 to 1 reaches the first cell of the lattice only; {}",
        file.name, extension, deviationText(deviation), cure));
}

}  // namespace

std::string formatWritten(const host::Node& node, const std::string& name) {
    const std::string type = node.value("file_type");
    return formatOf(name, type.find('.') == std::string::npos ? "" : type);
}

std::string reportGenerated(host::Node& node, Orlith::LUT::LUT3D& table, const Generated& file) {
    const std::string extension = formatWritten(node, file.name);
    if (!file.whyNotReadBack.empty()) {
        return summary(file.name, extension, table, "not verified: " + file.whyNotReadBack);
    }
    addPreLUT(table, node);
    const Options3DL options3DL = extension == ".3dl" ? options3DLOf(node) : Options3DL();
    const double deviation = verify(file.path, file.name, extension, table, options3DL);
    try {
        warnOfOtherLook(file, extension, table);
    } catch (const Failure& failure) {
        // The operator has written what it was given, such as samples that are not finite.
        warn(fmt::format("{} (as other programs read it)", failure.what()));
    }
    return summary(file.name, extension, table, "largest deviation " + deviationText(deviation));
}

}  // namespace orlith
