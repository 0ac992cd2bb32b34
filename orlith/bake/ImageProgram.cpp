#include "orlith/bake/ImageProgram.h"

#include <fmt/format.h>
#include <sys/wait.h>

#include <algorithm>
#include <boost/algorithm/string/replace.hpp>
#include <chrono>
#include <cstdio>
#include <cstring>
#include <string_view>

#include "host/Host.h"
#include "host/ProgressDisplay.h"
#include "host/Text.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/bake/Process.h"

namespace orlith {
namespace {

constexpr std::chrono::milliseconds kStep{50};

bool hasWord(const std::vector<std::string>& words, const char* part) {
    return std::any_of(words.begin(), words.end(), [&](const std::string& word) {
        return word.find(part) != std::string::npos;
    });
}

/// What a program prints: shown at once, and its end kept.
class Output {
public:
    explicit Output(const std::string& program) : program_(program) {}
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;
    /// What follows has a line of its own.
    ~Output() {
        if (!endsLine_) std::fputc('\n', stderr);
    }

    void add(const std::string& text) {
        if (text.empty()) return showTime();
        progress_.clear();
        std::fwrite(text.data(), 1, text.size(), stderr);
        std::fflush(stderr);
        endsLine_ = text.back() == '\n';
        end_ += text;
        if (end_.size() > 2 * kKeptBytes) end_.erase(0, end_.size() - kKeptBytes);
    }

    /// The last lines that say anything, in one.
    std::string lastWords() const {
        std::string_view rest = end_;
        std::vector<std::string_view> lines;
        while (!rest.empty() && lines.size() < kKeptLines) {
            const std::size_t before = rest.find_last_of("\r\n");
            const std::size_t start = before == std::string_view::npos ? 0 : before + 1;
            const std::string_view line = host::trimmed(rest.substr(start));
            if (!line.empty()) lines.insert(lines.begin(), line);
            rest = rest.substr(0, start == 0 ? 0 : before);
        }
        return fmt::format("{}", fmt::join(lines, "; "));
    }

private:
    static constexpr std::size_t kKeptBytes = 1000;
    static constexpr std::size_t kKeptLines = 3;

    /// Not over a line that the program has begun.
    void showTime() {
        const auto time = std::chrono::steady_clock::now() - start_;
        const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(time).count();
        if (endsLine_)
            progress_.status(fmt::format("{} is running, {} s", printable(program_), seconds));
    }

    const std::string& program_;
    const std::chrono::steady_clock::time_point start_ = std::chrono::steady_clock::now();
    host::ProgressDisplay progress_;
    bool endsLine_ = true;
    std::string end_;
};

std::string endText(int status) {
    return WIFSIGNALED(status) ? fmt::format("ended by signal {} ({})", WTERMSIG(status),
                                             strsignal(WTERMSIG(status)))
                               : fmt::format("failed with exit status {}", WEXITSTATUS(status));
}

}  // namespace

void expectImageWords(const std::vector<std::string>& words) {
    for (const char* const image : {"{in}", "{out}"}) {
        if (hasWord(words, image)) continue;
        throw UsageError(
            fmt::format("{} is missing behind --: there it stands for the image that PROGRAM {}",
                        image, std::strcmp(image, "{in}") == 0 ? "reads" : "writes"));
    }
}

void runImageProgram(const std::vector<std::string>& words, const std::string& in,
                     const std::string& out) {
    std::vector<std::string> arguments = words;
    for (std::string& word : arguments) {
        boost::replace_all(word, "{in}", in);
        boost::replace_all(word, "{out}", out);
    }
    Process process(arguments);
    Output output(words[0]);
    while (process.isRunning()) {
        if (host::Host::cancelRequested()) throw Cancelled();
        output.add(process.read(kStep));
    }
    std::string rest;
    const int status = process.finish(rest);
    if (!rest.empty()) output.add(rest);
    if (status == 0) return;
    const std::string lastWords = output.lastWords();
    throw Failure(fmt::format("{}: {}{}{}", words[0], endText(status),
                              lastWords.empty() ? "" : ": ", lastWords));
}

}  // namespace orlith
