#pragma once

#include <string>

#include "host/Node.h"

namespace orlith {

/// What a GenerateLUT node has just written.
struct Generated {
    std::string path;            ///< where the file is now
    std::string name;            ///< what people call it
    std::string whyNotReadBack;  ///< empty: read it back and compare it with the pattern
};

/// The format that the operator writes: its file type, or the name's extension where that is blank.
std::string formatWritten(const host::Node& node, const std::string& name);

/// Reads the node's file back and compares it with the pattern at its input.
/// @param node      executed without an error; its controls may change
/// @return          the line that says what was written
/// @throws Failure  the file is not what the pattern says
std::string reportGenerated(host::Node& node, const Generated& file);

}  // namespace orlith
