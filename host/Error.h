#pragma once

#include <stdexcept>

namespace host {

/// A failure, with a text for the user: one line, no prefix.
class Error : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

}  // namespace host
