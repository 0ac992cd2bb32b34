#pragma once

namespace host {

class Host;
class Node;
class PanelControl;

/// Runs the script of a node's button in Python, which the first one starts.
/// @throws Error  "NODE.CONTROL: type: text" of what the script raised
void runButtonScript(Host& host, Node& node, const PanelControl& button);

}  // namespace host
