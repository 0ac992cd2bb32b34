#pragma once

#include <stdexcept>
#include <string>
#include <vector>

namespace CLI {
class App;
}  // namespace CLI

namespace orlith {

/// Exit statuses of the program.
enum Status : int { kDone = 0, kFailed = 1, kWrongUsage = 2, kCancelled = 130 };

/// Ends a command with status 1 and its text on one line of standard error.
class Failure : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Ends a command with status 2.
class UsageError : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// Ends a command with status 130.
class Cancelled {};

// Each adds its command to the program; running it leaves the exit status in `status`.
void addPattern(CLI::App& program, int& status);
void addGenerate(CLI::App& program, int& status);
/// @param programWords  of the program that makes an image of an image
void addBake(CLI::App& program, const std::vector<std::string>& programWords, int& status);
void addApply(CLI::App& program, int& status);
void addConvert(CLI::App& program, int& status);
void addInfo(CLI::App& program, int& status);
void addEval(CLI::App& program, int& status);
void addDiff(CLI::App& program, int& status);
void addRun(CLI::App& program, int& status);
void addView(CLI::App& program, int& status);
void addPanel(CLI::App& program, int& status);

}  // namespace orlith
