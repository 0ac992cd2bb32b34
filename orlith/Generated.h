#pragma once

#include <string>

#include "host/Node.h"
#include "lut/LUT3D.h"

namespace orlith {

/// What a GenerateLUT node has just written.
struct Generated {
    std::string path;            ///< where the file is now
    std::string name;            ///< what people call it
    std::string whyNotReadBack;  ///< empty: read it back and compare it with the pattern
};

/// The format that the operator writes: its file type, or the name's extension where that is blank.
std::string formatWritten(const host::Node& node, const std::string& name);

/// Reads the node's file back and compares it with the pattern that it was made of.
/// @param node      executed without an error; its controls may change
/// @param table     of the pattern; gets the operator's pre-LUT
/// @return          the line that says what was written
/// @throws Failure  the file is not what the pattern says
std::string reportGenerated(host::Node& node, Orlith::LUT::LUT3D& table, const Generated& file);

}  // namespace orlith
