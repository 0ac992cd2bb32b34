#include "tests/orlith/Program.h"

#include <OpenImageIO/imageio.h>
#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>
#include <stdexcept>

#include "zefra/PatternLayout.h"

namespace test {
namespace {

constexpr unsigned kMostSeconds = 60;
constexpr int kExecFailed = 127;

std::vector<char*> pointers(const Words& words) {
    std::vector<char*> result;
    for (const std::string& word : words)
        result.push_back(const_cast<char*>(word.c_str()));
    result.push_back(nullptr);
    return result;
}

}  // namespace

Program::Program(const std::string& folder, const Words& arguments, const std::string& input,
                 const Words& environment) {
    Words command = {ORLITH_TEST_PROGRAM};
    command.insert(command.end(), arguments.begin(), arguments.end());
    Words variables;
    for (char** each = environ; *each != nullptr; ++each)
        variables.emplace_back(*each);
    // The first of a name counts.
    variables.insert(variables.begin(), environment.begin(), environment.end());
    const std::string paths[] = {streams_.write("in", input), streams_.path("out"),
                                 streams_.path("err")};
    const std::vector<char*> argv = pointers(command);
    const std::vector<char*> envp = pointers(variables);

    process_ = fork();
    if (process_ < 0) throw std::runtime_error("no process");
    if (process_ > 0) return;
    // Only calls that are safe between fork and exec.
    for (int stream = 0; stream < 3; ++stream) {
        const int flags = stream == 0 ? O_RDONLY : O_WRONLY | O_CREAT | O_TRUNC;
        const int file = open(paths[stream].c_str(), flags, 0600);
        if (file < 0 || dup2(file, stream) < 0) _exit(kExecFailed);
    }
    if (chdir(folder.c_str()) != 0) _exit(kExecFailed);
    alarm(kMostSeconds);
    execve(argv[0], argv.data(), envp.data());
    _exit(kExecFailed);
}

void Program::interrupt() const {
    EXPECT_EQ(kill(process_, SIGINT), 0);
}

Outcome Program::wait() {
    int status = 0;
    EXPECT_EQ(waitpid(process_, &status, 0), process_);
    return {WIFSIGNALED(status) ? 128 + WTERMSIG(status) : WEXITSTATUS(status),
            readFile(streams_.path("out")), readFile(streams_.path("err"))};
}

void writeImage(const std::string& path, int width, int height,
                const std::function<Pixel(int, int)>& pixel) {
    std::vector<Pixel> pixels;
    for (int y = height - 1; y >= 0; --y) {
        for (int x = 0; x < width; ++x)
            pixels.push_back(pixel(x, y));
    }
    const auto output = OIIO::ImageOutput::create(path);
    ASSERT_TRUE(output) << OIIO::geterror();
    ASSERT_TRUE(output->open(path, OIIO::ImageSpec(width, height, 3, OIIO::TypeFloat)));
    ASSERT_TRUE(output->write_image(OIIO::TypeFloat, pixels.data())) << output->geterror();
    ASSERT_TRUE(output->close());
}

Pixel markedLook(const Pixel& colour) {
    return {colour.r / 2 + 0.25F, colour.g * colour.g, 1 - colour.b};
}

void writePattern(const std::string& path, int points, const Look& look) {
    const int columns = zefra::PatternLayout::columns(points);
    const auto last = static_cast<float>(points - 1);
    writeImage(path, 7 * columns, 7 * zefra::PatternLayout::rows(points), [&](int x, int y) {
        const int index = y / 7 * columns + x / 7;
        const int green = index / points % points;
        const int blue = index / (points * points);
        return look({static_cast<float>(index % points) / last, static_cast<float>(green) / last,
                     static_cast<float>(blue) / last});
    });
}

std::string ProgramTest::output(const Words& arguments, const std::string& input) const {
    const Outcome outcome = run(arguments, input);
    EXPECT_EQ(outcome.status, 0) << ::testing::PrintToString(arguments);
    EXPECT_EQ(outcome.err, "");
    return outcome.out;
}

void ProgramTest::expect(const Words& arguments, int status, const std::string& out,
                         const std::string& err) const {
    SCOPED_TRACE(::testing::PrintToString(arguments));
    const Outcome outcome = run(arguments);
    EXPECT_EQ(outcome.status, status);
    EXPECT_EQ(outcome.out, out);
    EXPECT_EQ(outcome.err, err);
}

bool ProgramTest::exists(const std::string& name) const {
    return std::filesystem::exists(folder_.path(name));
}

}  // namespace test
