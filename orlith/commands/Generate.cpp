#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <algorithm>
#include <cerrno>

#include "host/Host.h"
#include "host/ProgressDisplay.h"
#include "orlith/Command.h"
#include "orlith/Generated.h"
#include "orlith/ImageOptions.h"
#include "orlith/Knobs.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "orlith/pattern/FlatPattern.h"
#include "orlith/pattern/PatternReading.h"
#include "orlith/table/TableFile.h"
#include "orlith/table/Verification.h"
#include "orlith/table/WriteOptions.h"

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
    {"--lut1d", "lut1d", "N", "Entries of the pre-LUT of .cms and .cub files (1024), 0: none"},
    {"--style1d", "style1d", "STYLE",
     "Ramp of the pre-LUT: linear, or logarithmic, which is a smooth step (default)"},
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

/// Sets the name, and the file type where only its letters' case keeps the operator from seeing it.
void setFile(host::Node& node, const std::string& path) {
    setKnob(node, "file", path);
    const std::string extension = formatOf(path, "");
    const auto& types = node.findControl("file_type")->items();
    const bool isType = std::find(types.begin(), types.end(), extension) != types.end();
    if (isType && node.findControl("file_type")->number() == 0) {
        node.setValue("file_type", extension);
    }
}

void setControls(host::Node& node, const GenerateOptions& options) {
    setFile(node, options.output);
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

/// Has the operator write to the staged file, in the type that it would write the file in.
void setStage(host::Node& node, const OutputFile& output) {
    const std::string type = node.value("file_type");
    node.setValue("file", output.stagedPath());
    node.setValue("file_type", type);
    // What was said while controls were set does not matter unless the execution fails, which then
    // has its own word for it.
    node.takeErrors();
}

/// @throws Failure  all that the operator and its inputs have to say
void execute(host::Node& node, const OutputFile& output) {
    host::ProgressDisplay progress;
    node.setProgress(&progress);
    errno = 0;
    node.execute();
    const int error = errno;
    node.setProgress(nullptr);
    output.expectNotCancelled();
    const auto errors = node.takeErrors();
    if (errors.empty()) return;
    const std::string text = output.inWords(fmt::format("{}", fmt::join(errors, "; ")));
    // What the input has to say begins with the name of its own file.
    const bool isAboutOutput = text.rfind("Error ", 0) == 0;
    throw Failure(isAboutOutput
                      ? fmt::format("{}: {}{}", output.name(), text, writeFailureReason(error))
                      : text);
}

int runGenerate(const GenerateOptions& options) {
    host::Host host;
    host.loadBundles();
    host::Node& read = createRead(host, options.image, options.choice);
    host::Node& generate = host.createNode("GenerateLUT");
    generate.connect(0, read);
    setControls(generate, options);

    zefra::Iop& image = openImage(read);
    const PatternReading pattern = readPattern(options.image, image, options.isForced);
    for (const std::string& text : pattern.warnings)
        warn(text);

    const std::string path = generate.value("file");
    if (path == "-" && formatWritten(generate, path).empty()) {
        throw UsageError("standard output has no extension: name the format by --file-type");
    }
    expectOtherFile(path, options.image);
    const std::string unreadable = whyUnreadable(formatWritten(generate, path), *pattern.table);
    if (!unreadable.empty()) throw Failure(fmt::format("{}: {}", path, unreadable));
    FlatPattern centres(read, image.box(), *pattern.table);
    generate.image()->setInput(0, &centres);
    OutputFile output(path);
    setStage(generate, output);
    execute(generate, output);
    const std::string line = reportGenerated(
        generate, *pattern.table,
        {output.stagedPath(), output.name(), output.whyNotReadBack(options.skipsVerification)});
    output.deliver();
    if (!options.isQuiet) output.print(line);
    return kDone;
}

}  // namespace

void addGenerate(CLI::App& program, int& status) {
    CLI::App* const command =
        addCommand(program, "generate", "Run the GenerateLUT operator on a processed test pattern");
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
        if (control == "lut1d") option->check(wrongPreLUTSize);
        if (control == "style1d") option->check(CLI::IsMember({"linear", "logarithmic"}));
        if (control == "bitdepth_id") option->check(CLI::IsMember(bitDepthWords()));
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
