#pragma once

#include <gtest/gtest.h>
#include <sys/types.h>

#include <filesystem>
#include <functional>
#include <initializer_list>
#include <string>

#include "tests/support/Files.h"

namespace test {

/// What a run of the program left behind.
struct Outcome {
    int status;  ///< exit status; 128 and the signal where one ended it
    std::string out;
    std::string err;
};

/// The program, running in a folder. One that hangs is ended after a minute.
class Program {
public:
    /// @param command  arguments, a blank between any two; '' is an empty one
    Program(const std::string& folder, const std::string& command, const std::string& input = "");

    void send(int signal) const;  ///< SIGINT: Ctrl-C
    Outcome wait();

private:
    TempFolder streams_;
    pid_t process_;
};

/// Red, green and blue of a pixel; rows are counted upward.
struct Pixel {
    float r, g, b;
};

/// Writes a float image.
void writeImage(const std::string& path, int width, int height,
                const std::function<Pixel(int x, int y)>& pixel);

/// A look that tells the channels apart: (r / 2 + 0.25, g * g, 1 - b).
Pixel markedLook(const Pixel& colour);

/// Writes the pattern of that many points, processed by a look.
void writePattern(const std::string& path, int points,
                  const std::function<Pixel(const Pixel&)>& look = markedLook);

/// A command, as for Program, and its exact outcome.
struct Case {
    const char* command;
    int status;
    const char *out, *err;
};

/// Runs of the program in a folder of their own.
class ProgramTest : public ::testing::Test {
protected:
    Outcome run(const std::string& command, const std::string& input = "") const {
        return Program(folder_.path(""), command, input).wait();
    }
    void expect(const std::string& command, int status, const std::string& out,
                const std::string& err) const;
    void expectAll(std::initializer_list<Case> cases) const {
        for (const Case& each : cases)
            expect(each.command, each.status, each.out, each.err);
    }

    /// Expects a run to succeed without a word on standard error; returns its output.
    std::string output(const std::string& command, const std::string& input = "") const;

    bool exists(const std::string& name) const {
        return std::filesystem::exists(folder_.path(name));
    }
    std::string read(const std::string& name) const { return readFile(folder_.path(name)); }

    TempFolder folder_;
};

/// Expects a text to be somewhere in another.
void expectIn(const std::string& text, const std::string& part);

}  // namespace test
