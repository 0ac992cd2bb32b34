#include "orlith/Knobs.h"

#include <CLI/CLI.hpp>

#include "host/Error.h"
#include "orlith/Command.h"

namespace orlith {

void addKnobOption(CLI::App& command, Knobs& knobs) {
    command
        .add_option_function<std::vector<std::string>>(
            "--knob",
            [&](const std::vector<std::string>& texts) {
                for (const std::string& text : texts) {
                    const std::size_t split = text.find('=');
                    if (split == std::string::npos || split == 0) {
                        throw CLI::ValidationError("--knob",
                                                   "\"" + text + "\" has to be NAME=VALUE");
                    }
                    knobs.emplace_back(text.substr(0, split), text.substr(split + 1));
                }
            },
            "Set any control, last of all; may be given again. Menus take an entry or its index")
        ->type_name("NAME=VALUE")
        ->allow_extra_args(false);
}

void setKnob(host::Node& node, const std::string& name, const std::string& value) {
    try {
        node.setValue(name, value);
    } catch (const host::Error& error) {
        throw UsageError(error.what());
    }
}

}  // namespace orlith
