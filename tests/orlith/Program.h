#pragma once

#include <gtest/gtest.h>
#include <sys/types.h>

#include <functional>
#include <string>
#include <vector>

#include "tests/support/Files.h"

namespace test {

using Words = std::vector<std::string>;

/// What a run of the program left behind.
struct Outcome {
    int status;  ///< exit status; 128 and the signal where one ended it
    std::string out;
    std::string err;
};

/// The program, running in a folder. One that hangs is ended after a minute.
class Program {
public:
    /// @param environment  "NAME=value" on top of the test's own
    Program(const std::string& folder, const Words& arguments, const std::string& input = "",
            const Words& environment = {});
    Program(const Program&) = delete;
    Program& operator=(const Program&) = delete;

    void interrupt() const;  ///< Ctrl-C
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

/// What a look does to the colour of a patch.
using Look = std::function<Pixel(const Pixel&)>;

/// A look that tells the channels apart: (r / 2 + 0.25, g * g, 1 - b).
Pixel markedLook(const Pixel& colour);

/// Writes a processed pattern of that many points; the file's name says in which format.
void writePattern(const std::string& path, int points, const Look& look = markedLook);

/// Runs of the program in a folder of their own.
class ProgramTest : public ::testing::Test {
protected:
    Outcome run(const Words& arguments, const std::string& input = "",
                const Words& environment = {}) const {
        return Program(folder_.path(""), arguments, input, environment).wait();
    }

    /// Expects the run to succeed without a word on standard error; returns its output.
    std::string output(const Words& arguments, const std::string& input = "") const;

    /// Expects exactly that outcome.
    void expect(const Words& arguments, int status, const std::string& out,
                const std::string& err) const;

    bool exists(const std::string& name) const;
    std::string read(const std::string& name) const { return readFile(folder_.path(name)); }

    TempFolder folder_;
};

}  // namespace test
