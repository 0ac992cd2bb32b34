#include "orlith/Signals.h"

#include <unistd.h>

#include <atomic>
#include <climits>
#include <csignal>
#include <cstring>

#include "host/Host.h"
#include "orlith/Command.h"

namespace orlith {
namespace {

enum class Work : int { None, Cancellable, Done };
std::atomic<Work> work{Work::None};

std::atomic<bool> endsInOrder{false};
std::atomic<int> signalPutOff{0};

char unfinishedFolder[PATH_MAX];
char unfinishedFile[PATH_MAX];
std::atomic<bool> hasUnfinishedFile{false};

static_assert(std::atomic<Work>::is_always_lock_free && std::atomic<bool>::is_always_lock_free &&
                  std::atomic<int>::is_always_lock_free,
              "a signal handler may not take a lock");

void removeUnfinishedFile() {
    if (!hasUnfinishedFile.exchange(false)) return;
    unlink(unfinishedFile);
    rmdir(unfinishedFolder);
}

void onInterrupt(int) {
    if (endsInOrder || (work != Work::None && !host::Host::cancelRequested())) {
        host::Host::requestCancel();
        return;
    }
    removeUnfinishedFile();
    _exit(kCancelled);
}

/// Ends the program as if the signal had never been caught.
void endBy(int signal) {
    std::signal(signal, SIG_DFL);
    raise(signal);
}

void onEnd(int signal) {
    if (endsInOrder) {
        signalPutOff = signal;
        host::Host::requestCancel();
        return;
    }
    removeUnfinishedFile();
    endBy(signal);
}

}  // namespace

void catchSignals() {
    std::signal(SIGINT, onInterrupt);
    for (const int signal : {SIGTERM, SIGHUP, SIGPIPE}) {
        // What was told to go on after a hang-up goes on.
        if (std::signal(signal, onEnd) == SIG_IGN) std::signal(signal, SIG_IGN);
    }
    std::signal(SIGXFSZ, SIG_IGN);
    // Whoever ignores it never hears how a child has ended.
    std::signal(SIGCHLD, SIG_DFL);
}

void endBySignal() {
    if (const int signal = signalPutOff; signal != 0) endBy(signal);
}

OrderlyEnd::OrderlyEnd() {
    endsInOrder = true;
}

OrderlyEnd::~OrderlyEnd() {
    endsInOrder = false;
}

CancelScope::CancelScope() {
    work = Work::Cancellable;
}

CancelScope::~CancelScope() {
    // What is done stays done, until the program ends or begins something else.
    if (work == Work::Cancellable) work = Work::None;
}

bool CancelScope::close() {
    work = Work::Done;
    return !host::Host::cancelRequested();
}

void CancelScope::release() {
    work = Work::None;
}

void setUnfinishedFile(const std::string& folder, const std::string& file) {
    if (folder.size() >= sizeof unfinishedFolder || file.size() >= sizeof unfinishedFile) return;
    std::memcpy(unfinishedFolder, folder.c_str(), folder.size() + 1);
    std::memcpy(unfinishedFile, file.c_str(), file.size() + 1);
    hasUnfinishedFile = true;
}

void forgetUnfinishedFile() {
    hasUnfinishedFile = false;
}

}  // namespace orlith
