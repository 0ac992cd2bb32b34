#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string_view>

#include "host/Host.h"
#include "host/ProgressDisplay.h"
#include "orlith/Command.h"
#include "orlith/Generated.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "orlith/pattern/PatternReading.h"

namespace orlith {
namespace {

constexpr std::string_view kTableOperator = "GenerateLUT";

struct RunOptions {
    std::string script;
    std::vector<std::string> presses;
};

std::string readScript(const std::string& path) {
    if (std::filesystem::is_directory(path)) throw Failure(path + ": is a folder");
    std::ifstream file(path, std::ios::binary);
    std::string text{std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    if (!file || file.bad()) throw Failure(path + ": cannot be read");
    return text;
}

/// All that the nodes have to say, each line with its node's name, which the host's own have.
std::vector<std::string> takeErrors(const host::Host& host) {
    std::vector<std::string> texts;
    for (const auto& node : host.nodes()) {
        for (const std::string& error : node->takeErrors()) {
            const std::string place = node->name() + ": ";
            texts.push_back(error.rfind(place, 0) == 0 ? error : place + error);
        }
    }
    return texts;
}

/// A button to press.
struct Button {
    host::Node* node;
    std::string control;
};

Button findButton(const host::Host& host, const std::string& target) {
    const std::size_t split = target.rfind('.');
    if (split == std::string::npos || split == 0) {
        throw UsageError(fmt::format("--press: \"{}\" has to be NODE.CONTROL", target));
    }
    const std::string name = target.substr(0, split);
    host::Node* const node = host.findNode(name);
    if (node == nullptr) throw UsageError(fmt::format("--press: no node \"{}\"", name));
    const std::string control = target.substr(split + 1);
    const host::PanelControl* const button = node->findControl(control);
    if (button == nullptr || button->kind() != host::PanelControl::Kind::ScriptButton) {
        throw UsageError(fmt::format("--press: {} has no button \"{}\"", node->name(), control));
    }
    return {node, control};
}

void press(host::Host& host, const Button& button) {
    host::ProgressDisplay progress;
    for (const auto& each : host.nodes())
        each->setProgress(&progress);
    host.press(*button.node, button.control);
    for (const auto& each : host.nodes())
        each->setProgress(nullptr);
    if (host::Host::cancelRequested()) throw Cancelled();
    for (const auto& node : host.nodes()) {
        for (const std::string& text : node->takeWarnings())
            warn(fmt::format("{}: {}", node->name(), text));
    }
    if (const auto errors = takeErrors(host); !errors.empty()) {
        throw Failure(fmt::format("{}", fmt::join(errors, "; ")));
    }
}

/// Says what a table's node has written, as generate does.
void report(host::Node& node) {
    const std::string path = node.value("file");
    if (path.empty()) {
        throw Failure(
            fmt::format("{}: nothing was written: its control \"file\" is empty", node.name()));
    }
    // The file is written already: what is wrong with the pattern can only be said.
    const PatternReading pattern = readPattern(node.name(), node.image()->input(0), true);
    for (const std::string& text : pattern.warnings)
        warn(text);
    const std::string reason = isStream(path) ? "a pipe or a device is not read back" : "";
    fmt::print("{}", reportGenerated(node, *pattern.table, {path, path, reason}));
}

int runRun(const RunOptions& options) {
    const CancelScope scope;
    host::Host host;
    host.loadBundles();
    host.runScript(readScript(options.script), options.script);
    for (const std::string& text : takeErrors(host))
        warn(text);
    std::vector<Button> buttons;
    for (const std::string& target : options.presses)
        buttons.push_back(findButton(host, target));
    for (const Button& button : buttons) {
        for (const auto& node : host.nodes())
            node->clearExecutions();
        press(host, button);
        for (const auto& node : host.nodes()) {
            if (node->executions() > 0 && node->className() == kTableOperator) report(*node);
        }
    }
    return kDone;
}

}  // namespace

void addRun(CLI::App& program, int& status) {
    CLI::App* const command =
        addCommand(program, "run", "Load a script of saved nodes and press buttons");
    const auto options = std::make_shared<RunOptions>();
    command->add_option("SCRIPT", options->script, "Saved nodes (Tcl)")->required();
    command
        ->add_option(
            "--press", options->presses,
            "Button to press; may be given again. NODE is a name, or a class with one node")
        ->type_name("NODE.CONTROL")
        ->allow_extra_args(false);
    command->callback([options, &status] { status = runRun(*options); });
}

}  // namespace orlith
