#include <fmt/format.h>

#include <algorithm>

#include "host/Host.h"
#include "host/ProgressDisplay.h"
#include "orlith/Cancellation.h"
#include "orlith/Command.h"
#include "orlith/ImageOptions.h"
#include "orlith/Knobs.h"
#include "orlith/PatternReading.h"
#include "orlith/TableFile.h"
#include "orlith/Verification.h"
#include "orlith/WriteOptions.h"

namespace orlith {
namespace {

struct GenerateOptions {
    std::string image;
    host::ImageChoice choice;
    std::string output;
    Knobs controls;  // of the options, in the order in which they are set
    Knobs knobs;
    bool isForced = false;
    bool skipsVerification = false;
    bool isQuiet = false;
};

/// The options of the operator's own controls, in the order in which they are set.
struct ControlOption {
    const char* option;
    const char* control;
    const char* typeName;
    const char* description;
};

constexpr ControlOption kControlOptions[] = {
    {"--file-type", "file_type", "EXT", "Format, such as .3dl; an empty text: by the file's name"},
    {"--lut1d", "lut1d", "N", "Entries of the pre-LUT (1024); not for .3dl"},
    {"--style1d", "style1d", "STYLE", "Ramp of the pre-LUT: linear or logarithmic (default)"},
    {"--bitdepth", "bitdepth_id", "BITS", "Bits of a .3dl file's input grid: 4 8 10 12 16 (10)"},
    {"--output-bitdepth", "output_bitdepth_id", "BITS", "Bits of a .3dl file's codes, or input"},
    {"--clamp-output", "clamp_output", nullptr, "Clamp a .3dl file's codes to their bits"},
    {"--format-3dl", "format_3dl_id", "DIALECT", "Dialect of a .3dl file: flame, lustre, scratch"},
};

/// The word of the command line as the operator's menus have it.
std::string menuText(const std::string& control, const std::string& word) {
    if (control == "bitdepth_id") return word + " bit";
    if (control == "output_bitdepth_id") return word == "input" ? "input bit depth" : word + " bit";
    if (control == "format_3dl_id") {
        if (word == "flame") return "autodesk flame/smoke";
        return (word == "lustre" ? "autodesk " : "assimulate ") + word;
    }
    if (control == "file_type") return withDot(word);
    return word;
}

/// The options that a .3dl file was written with, from the operator's controls.
Options3DL options3DLOf(host::Node& node) {
    // They show while .3dl is the file type; hidden ones keep their values.
    node.setValue("file_type", ".3dl");
    const auto index = [&](const char* name) { return node.findControl(name)->number(); };
    // The operator takes the last entry for an index beyond them.
    const auto bits = [](int entry) {
        return bitDepths()[std::min(static_cast<std::size_t>(entry), bitDepths().size() - 1)];
    };
    WriteOptions options;
    options.bitDepth = bits(index("bitdepth_id"));
    if (const int output = index("output_bitdepth_id"); output > 0) {
        options.outputBitDepth = bits(output - 1);
    }
    options.clampOutput = index("clamp_output") != 0;
    constexpr const char* kDialects[] = {"flame", "lustre", "scratch"};
    options.format3DL = kDialects[index("format_3dl_id")];
    return options.options3DL();
}

/// The pre-LUT that the operator gives to a table.
void addPreLUT(Orlith::LUT::LUT& lut, const host::Node& node) {
    const host::PanelControl* const entryCount = node.findControl("lut1d");
    if (!entryCount->hasValue()) return;  // no pre-LUT in a .3dl file
    setPreLUT(lut, entryCount->number(), node.value("style1d"));
}

/// The format that the operator wrote: its file type, or the name's extension where that is blank.
std::string formatWritten(const host::Node& node, const std::string& path) {
    const std::string type = node.value("file_type");
    return formatOf(path, type.find('.') == std::string::npos ? "" : type);
}

void setControls(host::Node& node, const GenerateOptions& options) {
    setKnob(node, "file", options.output);
    for (const auto& [control, word] : options.controls) {
        const host::PanelControl* const found = node.findControl(control);
        if (found == nullptr || !found->hasValue()) {
            throw UsageError(fmt::format("{} is not a control of {} files", control,
                                         formatWritten(node, options.output)));
        }
        setKnob(node, control, menuText(control, word));
    }
    for (const auto& [name, value] : options.knobs)
        setKnob(node, name, value);
}

int runGenerate(const GenerateOptions& options) {
    host::Host host;
    host.loadBundles();
    host::Node& read = createRead(host, options.image, options.choice);
    host::Node& generate = host.createNode("GenerateLUT");
    generate.connect(0, read);
    setControls(generate, options);
    // What was said while controls were set does not matter unless the execution fails, which then
    // has its own word for it.
    generate.takeErrors();
    const std::string path = generate.value("file");
    if (path.empty()) throw UsageError("the output file has no name");

    zefra::Iop& image = openImage(read);
    const PatternReading pattern = readPattern(options.image, image, options.isForced);
    for (const std::string& text : pattern.warnings)
        warn(text);

    const CancellableOutput output(path);
    {
        host::ProgressDisplay progress;
        generate.setProgress(&progress);
        generate.execute();
        generate.setProgress(nullptr);
    }
    output.expectNotCancelled();
    if (const auto errors = generate.takeErrors(); !errors.empty()) {
        throw Failure(fmt::format("{}", fmt::join(errors, "; ")));
    }

    const std::string extension = formatWritten(generate, path);
    const auto& table = pattern.table;
    addPreLUT(*table, generate);
    Verification verification;
    verification.reason = "--no-verify";
    if (!options.skipsVerification) {
        const Options3DL options3DL = extension == ".3dl" ? options3DLOf(generate) : Options3DL();
        verification = verify(path, extension, *table, options3DL);
    }
    output.expectNotCancelled();
    if (!options.isQuiet) fmt::print("{}", summary(path, extension, *table, verification));
    return kDone;
}

}  // namespace

void addGenerate(CLI::App& program, int& status) {
    CLI::App* const command = program.add_subcommand(
        "generate", "Run the GenerateLUT operator on a processed test pattern");
    const auto options = std::make_shared<GenerateOptions>();
    command->add_option("IMAGE", options->image, "Processed pattern: EXR, TIFF, DPX, PNG ...")
        ->required();
    command->add_option("OUT_LUT", options->output, "File to write; its extension names the format")
        ->required();
    for (const ControlOption& each : kControlOptions) {
        const std::string control = each.control;
        if (control == "clamp_output") {
            command->add_flag_function(
                "--clamp-output,!--no-clamp-output",
                [options, control](std::int64_t count) {
                    options->controls.emplace_back(control, count > 0 ? "true" : "false");
                },
                each.description);
            continue;
        }
        auto* const option = command->add_option_function<std::string>(
            each.option,
            [options, control](const std::string& word) {
                options->controls.emplace_back(control, word);
            },
            each.description);
        option->type_name(each.typeName);
        if (control == "style1d") option->check(CLI::IsMember({"linear", "logarithmic"}));
        if (control == "bitdepth_id") option->check(CLI::IsMember({"4", "8", "10", "12", "16"}));
        if (control == "output_bitdepth_id") {
            option->check(CLI::IsMember({"input", "4", "8", "10", "12", "16"}));
        }
        if (control == "format_3dl_id") {
            option->check(CLI::IsMember({"flame", "lustre", "scratch"}));
        }
    }
    addKnobOption(*command, options->knobs);
    addImageChoice(*command, options->choice);
    command->add_flag("--force", options->isForced,
                      "Take an image that does not look like a pattern");
    command->add_flag("--no-verify", options->skipsVerification,
                      "Do not read the written file back to compare it");
    command->add_flag("--quiet", options->isQuiet, "Do not say what was written");
    command->callback([options, &status] { status = runGenerate(*options); });
}

}  // namespace orlith
