#include <fcntl.h>
#include <fmt/format.h>
#include <unistd.h>
#include <CLI/CLI.hpp>

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <new>
#include <system_error>
#include <utility>

#include "host/Host.h"
#include "lut/Exception.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/Signals.h"

namespace orlith {
namespace {

constexpr char kDescription[] =
    "Makes look-up tables of image programs and processed test patterns, applies them to images, "
    "and reads, converts, evaluates and compares them.\nExit status: 0 done, 1 failed, 2 wrong "
    "usage, 130 cancelled.";

/// Where a standard stream is closed, the next file that is opened would take its place and get
/// what is printed. Something that refuses to be used takes it instead.
void holdStandardStreams() {
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO}) {
        if (fcntl(stream, F_GETFD) >= 0 || errno != EBADF) continue;
        // The lowest free number is this stream's.
        static_cast<void>(open("/dev/null", stream == STDIN_FILENO ? O_WRONLY : O_RDONLY) == 0);
    }
}

/// Takes the words of another program away, which stand behind "--" and are nobody else's.
std::vector<std::string> takeProgramWords(int& argc, char** argv) {
    char** const end = argv + argc;
    if (argc < 2 || std::strcmp(argv[1], "bake") != 0) return {};
    char** const mark =
        std::find_if(argv, end, [](const char* word) { return std::strcmp(word, "--") == 0; });
    if (mark == end) return {};
    argc = static_cast<int>(mark - argv);
    return {mark + 1, end};
}

/// What fails because the user has cancelled is no failure.
int fail(int status, const std::string& text) {
    if (host::Host::cancelRequested()) return kCancelled;
    printError(text);
    return status;
}

std::vector<std::string> commandNames(const CLI::App& program) {
    std::vector<std::string> names;
    for (const CLI::App* const command : program.get_subcommands({}))
        names.push_back(command->get_name());
    return names;
}

std::vector<std::string> optionNames(const CLI::App& command) {
    std::vector<std::string> names;
    for (const CLI::Option* const option : command.get_options()) {
        for (const std::string& name : option->get_lnames())
            names.push_back("--" + name);
    }
    return names;
}

std::string withNearest(const std::string& problem, const std::string& word,
                        const std::vector<std::string>& names) {
    const auto nearest = nearestName(word, names);
    return nearest ? fmt::format("{} \"{}\"; did you mean \"{}\"?", problem, word, *nearest)
                   : fmt::format("{} \"{}\"", problem, word);
}

/// Answers for a first word that is neither a command nor an option.
void expectKnown(const CLI::App& program, const std::string& word) {
    const bool isOption = word.rfind('-', 0) == 0;
    const auto names = isOption ? optionNames(program) : commandNames(program);
    if (word == "-h" || std::find(names.begin(), names.end(), word) != names.end()) return;
    const char* const problem = isOption ? "unknown option" : "unknown command";
    throw UsageError(withNearest(problem, word, names) + " (see orlith --help)");
}

/// What is wrong with the command line, and where to read how it is right.
std::string usageProblem(const CLI::App& program, const CLI::ParseError& error) {
    const auto chosen = program.get_subcommands();
    if (chosen.empty()) return "a command is needed (see orlith --help)";
    const CLI::App& command = *chosen.front();
    std::string problem = error.what();
    const auto surplus = program.remaining(true);
    if (command.get_name() == "bake" &&
        std::find(surplus.begin(), surplus.end(), "{in}") != surplus.end()) {
        problem = "PROGRAM and its words stand behind --";
    }
    if (!surplus.empty() && surplus.front().rfind("--", 0) == 0) {
        const std::string word = surplus.front().substr(0, surplus.front().find('='));
        problem = withNearest("unknown option", word, optionNames(command));
    }
    return fmt::format("{} (see orlith --help and orlith {} --help)", problem, command.get_name());
}

/// Standard output may be a full disk or closed.
int failToPrint(int error) {
    return fail(kFailed, fmt::format("standard output cannot be written: {}",
                                     std::generic_category().message(error)));
}

/// Runs the command line; every failure ends here as one line and an exit status.
int run(CLI::App& program, int argc, char** argv, const int& status) {
    try {
        expectKnown(program, argc > 1 ? argv[1] : "--help");
        std::vector<std::string> words;  // the last one first, as the parser wants them
        for (int i = argc - 1; i > 0; --i)
            words.push_back(markedNegative(argv[i]));
        program.parse(std::move(words));
        return status;
    } catch (const CLI::Success& request) {  // --help, --version
        return program.exit(request);
    } catch (const CLI::ParseError& error) {
        return fail(kWrongUsage, usageProblem(program, error));
    } catch (const UsageError& error) {
        return fail(kWrongUsage, error.what());
    } catch (const Cancelled&) {
        return kCancelled;
    } catch (const Orlith::LUT::Exception& exception) {
        return fail(kFailed, exception.message());
    } catch (const std::bad_alloc&) {
        return fail(kFailed, "out of memory");
    } catch (const std::system_error& error) {  // as {fmt} reports what it could not print
        return std::ferror(stdout) != 0 ? failToPrint(error.code().value())
                                        : fail(kFailed, error.what());
    } catch (const std::exception& error) {
        return fail(kFailed, error.what());
    }
}

}  // namespace
}  // namespace orlith

int main(int argc, char** argv) {
    orlith::holdStandardStreams();
    orlith::catchSignals();

    int status = orlith::kDone;
    const auto programWords = orlith::takeProgramWords(argc, argv);
    CLI::App program(orlith::kDescription, "orlith");
    program.set_version_flag("--version", "orlith " ORLITH_VERSION);
    program.require_subcommand(1);
    orlith::addPattern(program, status);
    orlith::addGenerate(program, status);
    orlith::addBake(program, programWords, status);
    orlith::addApply(program, status);
    orlith::addConvert(program, status);
    orlith::addInfo(program, status);
    orlith::addEval(program, status);
    orlith::addDiff(program, status);
    orlith::addView(program, status);
    orlith::addRun(program, status);
    orlith::addPanel(program, status);
    status = orlith::run(program, argc, argv, status);
    orlith::endBySignal();
    // Results that could not be delivered (a full disk behind a redirection) are a failure.
    errno = 0;
    if ((std::fflush(stdout) != 0 || std::ferror(stdout) != 0) && status == orlith::kDone) {
        return orlith::failToPrint(errno != 0 ? errno : EIO);
    }
    return status;
}
