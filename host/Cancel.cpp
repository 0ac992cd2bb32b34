#include "host/Cancel.h"

#include <atomic>

namespace host {
namespace {

std::atomic<bool> requested{false};
static_assert(std::atomic<bool>::is_always_lock_free, "a signal handler may not take a lock");

}  // namespace

void requestCancel() noexcept {
    requested.store(true);
}

bool cancelRequested() noexcept {
    return requested.load();
}

void clearCancel() noexcept {
    requested.store(false);
}

}  // namespace host
