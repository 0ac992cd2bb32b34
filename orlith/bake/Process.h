#pragma once

#include <sys/types.h>

#include <chrono>
#include <string>
#include <vector>

namespace orlith {

/// Another program that runs beside this one, started without a shell.
///
/// It leads a session of its own, so that Ctrl-C reaches it only through whoever owns this object.
/// Its standard input is empty; what it prints, on standard output or standard error, is read here.
class Process {
public:
    /// @param words     the program, searched on PATH unless it has a slash, and its arguments
    /// @throws Failure  it cannot be run, with the system's reason
    explicit Process(const std::vector<std::string>& words);
    Process(const Process&) = delete;
    Process& operator=(const Process&) = delete;
    /// Ends it with all that it has started: asks, and after a while does not ask any more.
    ~Process();

    bool isRunning() const;

    /// What it has printed since, as soon as there is anything; empty if there is nothing within
    /// the time.
    std::string read(std::chrono::milliseconds time);

    /// Takes leave of a program that has ended, and ends what it has left running.
    /// @param rest  gets what has not been read
    /// @return      as waitpid has it
    int finish(std::string& rest);

private:
    void kill(int signal) const;

    pid_t process_ = -1;
    int output_ = -1;  // the reading end, which does not block; -1 behind the end of it
};

}  // namespace orlith
