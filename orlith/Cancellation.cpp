#include "orlith/Cancellation.h"

#include <unistd.h>

#include <csignal>
#include <system_error>
#include <utility>

#include "host/Host.h"
#include "orlith/Command.h"

namespace orlith {
namespace {

namespace fs = std::filesystem;

volatile std::sig_atomic_t hasScope = 0;

void onInterrupt(int) {
    if (hasScope == 0 || host::Host::cancelRequested()) _exit(kCancelled);
    host::Host::requestCancel();
}

/// The earliest time of all for a file that is not there.
fs::file_time_type writeTime(const std::string& path) {
    std::error_code failure;
    const fs::file_time_type time = fs::last_write_time(path, failure);
    return failure ? fs::file_time_type::min() : time;
}

}  // namespace

void catchInterrupts() {
    std::signal(SIGINT, onInterrupt);
}

CancelScope::CancelScope() {
    hasScope = 1;
}

CancelScope::~CancelScope() {
    hasScope = 0;
}

CancellableOutput::CancellableOutput(std::string path)
    : path_(std::move(path)), timeBefore_(writeTime(path_)) {}

void CancellableOutput::expectNotCancelled() const {
    if (!host::Host::cancelRequested()) return;
    std::error_code ignored;
    if (fs::is_regular_file(path_, ignored) && writeTime(path_) != timeBefore_) {
        fs::remove(path_, ignored);
    }
    throw Cancelled();
}

}  // namespace orlith
