#pragma once

#include <filesystem>
#include <string>

namespace orlith {

/// Ctrl-C ends the program at once with status 130, unless a CancelScope lives.
void catchInterrupts();

/// While one lives, Ctrl-C is a request, host::Host::cancelRequested(), and the work in hand ends
/// in order. A second Ctrl-C does not wait for that. Not nested.
class CancelScope {
public:
    CancelScope();
    CancelScope(const CancelScope&) = delete;
    CancelScope& operator=(const CancelScope&) = delete;
    ~CancelScope();
};

/// The file that a command is going to write, and a CancelScope while it does: a cancelled command
/// leaves none behind.
class CancellableOutput {
public:
    explicit CancellableOutput(std::string path);

    /// @throws Cancelled  if the user has cancelled; what was written until then is removed
    void expectNotCancelled() const;

private:
    CancelScope scope_;
    std::string path_;
    std::filesystem::file_time_type timeBefore_;
};

}  // namespace orlith
