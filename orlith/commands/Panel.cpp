#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include "host/Host.h"
#include "orlith/Command.h"
#include "orlith/Knobs.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"

namespace orlith {
namespace {

using Kind = host::PanelControl::Kind;

constexpr const char kBold[] = "@b;";

std::string withoutMarkup(std::string text) {
    if (text.rfind(kBold, 0) == 0) text.erase(0, sizeof kBold - 1);
    return text;
}

/// A menu's entries with the chosen one in brackets; otherwise the value.
std::string valueText(const host::PanelControl& control) {
    if (control.kind() != Kind::Enumeration) return control.valueText();
    std::string entries;
    for (std::size_t i = 0; i < control.items().size(); ++i) {
        const bool isChosen = static_cast<int>(i) == control.number();
        entries +=
            fmt::format(isChosen ? "{}[{}]" : "{}{}", i == 0 ? "" : " | ", control.items()[i]);
    }
    const bool isBeyond = control.number() >= static_cast<int>(control.items().size());
    return isBeyond ? fmt::format("{} | [{}]", entries, control.number()) : entries;
}

int runPanel(const Knobs& knobs) {
    host::Host host;
    host.loadBundles();
    host::Node& node = host.createNode("GenerateLUT");
    for (const auto& [name, value] : knobs)
        setKnob(node, name, value);
    for (const std::string& error : node.takeErrors())
        warn(error);

    fmt::print("{}\n", node.name());
    for (const auto& control : node.controls()) {
        switch (control->kind()) {
            case Kind::Obsolete:  // not shown to anyone
                break;
            case Kind::TextLine:
                fmt::print("\n{}\n", withoutMarkup(control->label()));
                break;
            case Kind::ScriptButton:
                fmt::print("  ({})  {}\n", control->label(), control->name());
                break;
            default:
                fmt::print("  {:<26}{:<20}{}\n", control->label(), control->name(),
                           printable(valueText(*control)));
        }
    }
    return kDone;
}

}  // namespace

void addPanel(CLI::App& program, int& status) {
    CLI::App* const command =
        addCommand(program, "panel", "Show the operator's controls as its panel does");
    const auto knobs = std::make_shared<Knobs>();
    addKnobOption(*command, *knobs);
    command->callback([knobs, &status] { status = runPanel(*knobs); });
}

}  // namespace orlith
