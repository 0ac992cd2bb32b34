#include "orlith/bake/Process.h"

#include <fcntl.h>
#include <fmt/format.h>
#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <csignal>
#include <system_error>
#include <thread>

#include "orlith/Command.h"

// POSIX leaves the declaration to whoever uses it, but some headers have it.
extern char** environ;  // NOLINT(readability-redundant-declaration)

namespace orlith {
namespace {

using namespace std::chrono_literals;

constexpr auto kGrace = 2s;  // to clear up in
constexpr auto kStep = 20ms;
constexpr int kMostRestBlocks = 64;  // more than a pipe holds: who fills it again is not waited for

std::string systemText(int error) {
    return std::generic_category().message(error);
}

/// How a program is started: nothing of this one but its working folder and its environment.
class Start {
public:
    explicit Start(int output) {
        posix_spawn_file_actions_init(&files_);
        posix_spawn_file_actions_addopen(&files_, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_adddup2(&files_, output, STDOUT_FILENO);
        posix_spawn_file_actions_adddup2(&files_, output, STDERR_FILENO);
        posix_spawnattr_init(&attributes_);
        posix_spawnattr_setflags(&attributes_, POSIX_SPAWN_SETSID | POSIX_SPAWN_SETSIGDEF);
        // What is caught here is as it was in the new program; what is ignored would stay so.
        sigset_t ignored;
        sigemptyset(&ignored);
        sigaddset(&ignored, SIGXFSZ);
        posix_spawnattr_setsigdefault(&attributes_, &ignored);
    }
    Start(const Start&) = delete;
    Start& operator=(const Start&) = delete;
    ~Start() {
        posix_spawnattr_destroy(&attributes_);
        posix_spawn_file_actions_destroy(&files_);
    }

    /// @return 0 or an error number
    int run(const std::vector<std::string>& words, pid_t& process) const {
        std::vector<char*> arguments;
        arguments.reserve(words.size() + 1);
        for (const std::string& word : words)
            arguments.push_back(const_cast<char*>(word.c_str()));
        arguments.push_back(nullptr);
        return posix_spawnp(&process, arguments[0], &files_, &attributes_, arguments.data(),
                            environ);
    }

private:
    posix_spawn_file_actions_t files_{};
    posix_spawnattr_t attributes_{};
};

}  // namespace

Process::Process(const std::vector<std::string>& words) {
    int ends[2];
    if (pipe(ends) != 0) throw Failure(fmt::format("{}: {}", words[0], systemText(errno)));
    // Nobody else gets them, or the end of the output would never come.
    for (const int end : ends)
        fcntl(end, F_SETFD, FD_CLOEXEC);
    fcntl(ends[0], F_SETFL, O_NONBLOCK);
    const int error = Start(ends[1]).run(words, process_);
    close(ends[1]);
    output_ = ends[0];
    if (error == 0) return;
    close(output_);
    throw Failure(fmt::format("{}: cannot be run: {}", words[0], systemText(error)));
}

Process::~Process() {
    if (process_ > 0) {
        for (const int signal : {SIGTERM, SIGKILL}) {
            kill(signal);
            const auto end = std::chrono::steady_clock::now() + kGrace;
            // It may want to say something first: nobody has to wait for a full pipe.
            while (isRunning() && std::chrono::steady_clock::now() < end)
                read(kStep);
        }
        // What is still there belongs to somebody else, or waits for a device.
        if (std::string unread; !isRunning()) finish(unread);
    }
    if (output_ >= 0) close(output_);
}

bool Process::isRunning() const {
    siginfo_t info{};
    // Its number stays its own until finish.
    const int result =
        waitid(P_PID, static_cast<id_t>(process_), &info, WEXITED | WNOHANG | WNOWAIT);
    return result == 0 && info.si_pid == 0;
}

std::string Process::read(std::chrono::milliseconds time) {
    pollfd waiting{output_, POLLIN, 0};
    if (output_ < 0) std::this_thread::sleep_for(std::min(time, std::chrono::milliseconds(kStep)));
    if (output_ < 0 || poll(&waiting, 1, static_cast<int>(time.count())) <= 0) return "";
    std::array<char, 65536> block;
    const ssize_t count = ::read(output_, block.data(), block.size());
    if (count > 0) return {block.data(), static_cast<std::size_t>(count)};
    if (count == 0) {
        close(output_);
        output_ = -1;
    }
    return "";
}

int Process::finish(std::string& rest) {
    kill(SIGKILL);
    for (int block = 0; block < kMostRestBlocks && output_ >= 0; ++block) {
        const std::string text = read(0ms);
        if (text.empty()) break;
        rest += text;
    }
    int status = 0;
    while (waitpid(process_, &status, 0) < 0 && errno == EINTR) {
    }
    process_ = -1;
    return status;
}

void Process::kill(int signal) const {
    // The group of that number exists as long as its leader has not been waited for.
    ::kill(-process_, signal);
}

}  // namespace orlith
