#pragma once

#include <chrono>
#include <cstdio>
#include <string>

namespace host {

/// One line at the bottom of a terminal that shows what is being done and how far it is:
///
///     Analyzing frame [########            ]  40%
///
/// Redrawn at most 20 times a second; erased by clear and at the end.
class ProgressDisplay {
public:
    /// On standard error; silent where that is no terminal.
    ProgressDisplay();
    /// @param isShown  false: draws nothing at all
    ProgressDisplay(std::FILE* terminal, bool isShown);
    ProgressDisplay(const ProgressDisplay&) = delete;
    ProgressDisplay& operator=(const ProgressDisplay&) = delete;
    ~ProgressDisplay();

    void message(const std::string& text);
    /// @param done  0 to 1
    void fraction(double done);
    /// A text alone, of work that does not say how far it is.
    void status(const std::string& text);
    void clear();

private:
    using Clock = std::chrono::steady_clock;

    void draw();
    void show(const std::string& text);

    std::FILE* terminal_;
    bool isShown_;
    bool isDrawn_ = false;
    std::string message_;
    double fraction_ = 0.0;
    Clock::time_point nextDraw_;
};

}  // namespace host
