#pragma once

namespace host {

// Whether the user has cancelled. Requesting it is all that a signal handler has to do.

void requestCancel() noexcept;  ///< may be called from a signal handler
bool cancelRequested() noexcept;
void clearCancel() noexcept;

}  // namespace host
