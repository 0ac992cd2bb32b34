#pragma once

#include <stdexcept>
#include <string>

#include "zefra/Export.h"

namespace host {

/// A failure, with a text for the user: one line, no prefix. Loaded modules throw it too.
class ZEFRA_EXPORT Error : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
    /// What is wrong with a file.
    Error(const std::string& path, const std::string& reason)
        : runtime_error(path + ": " + reason) {}
};

}  // namespace host
