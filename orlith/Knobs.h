#pragma once

#include <string>
#include <utility>
#include <vector>

#include "host/Node.h"

namespace CLI {
class App;
}  // namespace CLI

namespace orlith {

using Knobs = std::vector<std::pair<std::string, std::string>>;

/// Adds --knob NAME=VALUE.
void addKnobOption(CLI::App& command, Knobs& knobs);

/// Sets a control, as a person at the panel would.
/// @throws UsageError  no such control on the panel now, or a value that does not fit it
void setKnob(host::Node& node, const std::string& name, const std::string& value);

}  // namespace orlith
