#include "tests/orlith/Program.h"

#include <OpenImageIO/imageio.h>
#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <csignal>
#include <stdexcept>
#include <vector>

#include "zefra/PatternLayout.h"

namespace test {

Program::Program(const std::string& folder, const std::string& command, const std::string& input) {
    constexpr unsigned kMostSeconds = 60;
    constexpr int kExecFailed = 127;
    std::vector<std::string> words = {ORLITH_TEST_PROGRAM};
    std::size_t start = 0;
    while (start < command.size()) {
        const std::size_t end = std::min(command.find(' ', start), command.size());
        const std::string word = command.substr(start, end - start);
        words.push_back(word == "''" ? "" : word);
        start = end + 1;
    }
    std::vector<char*> argv(words.size() + 1);  // ended by a null pointer
    std::transform(words.begin(), words.end(), argv.begin(),
                   [](std::string& word) { return word.data(); });
    const std::string streams[] = {streams_.write("in", input), streams_.write("out", ""),
                                   streams_.write("err", "")};

    process_ = fork();
    if (process_ < 0) throw std::runtime_error("no process");
    if (process_ > 0) return;
    for (int stream = 0; stream < 3; ++stream) {
        const int flags = stream == 0 ? O_RDONLY : O_WRONLY;
        const int file = open(streams[stream].c_str(), flags, 0600);
        if (file < 0 || dup2(file, stream) < 0) _exit(kExecFailed);
    }
    if (chdir(folder.c_str()) != 0) _exit(kExecFailed);
    alarm(kMostSeconds);
    execv(argv[0], argv.data());
    _exit(kExecFailed);
}

void Program::send(int signal) const {
    EXPECT_EQ(kill(process_, signal), 0);
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
    ASSERT_TRUE(output->open(path, OIIO::ImageSpec(width, height, 3, OIIO::TypeFloat)) &&
                output->write_image(OIIO::TypeFloat, pixels.data()) && output->close())
        << output->geterror();
}

Pixel markedLook(const Pixel& colour) {
    return {colour.r / 2 + 0.25F, colour.g * colour.g, 1 - colour.b};
}

void writePattern(const std::string& path, int points,
                  const std::function<Pixel(const Pixel&)>& look) {
    using Layout = zefra::PatternLayout;
    const int columns = Layout::columns(points);
    const auto value = [&](int point) {
        return static_cast<float>(point % points) / static_cast<float>(points - 1);
    };
    writeImage(path, 7 * columns, 7 * Layout::rows(points), [&](int x, int y) {
        const int index = y / 7 * columns + x / 7;
        if (index >= points * points * points) return look({0, 0, 0});  // padding
        return look({value(index), value(index / points), value(index / points / points)});
    });
}

std::string ProgramTest::output(const std::string& command, const std::string& input) const {
    const Outcome outcome = run(command, input);
    EXPECT_EQ(outcome.status, 0) << command;
    EXPECT_EQ(outcome.err, "") << command;
    return outcome.out;
}

void ProgramTest::expect(const std::string& command, int status, const std::string& out,
                         const std::string& err) const {
    const Outcome outcome = run(command);
    EXPECT_EQ(outcome.status, status) << command;
    EXPECT_EQ(outcome.out, out) << command;
    EXPECT_EQ(outcome.err, err) << command;
}

void expectIn(const std::string& text, const std::string& part) {
    EXPECT_NE(text.find(part), std::string::npos) << part << "\n is not in\n" << text;
}

}  // namespace test
