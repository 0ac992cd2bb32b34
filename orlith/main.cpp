#include <fmt/format.h>

#include <cstdio>
#include <new>

#include "host/Host.h"
#include "lut/Exception.h"
#include "orlith/Cancellation.h"
#include "orlith/Command.h"

namespace orlith {
namespace {

constexpr char kDescription[] =
    "Makes look-up tables from processed test patterns, and reads, converts, evaluates and "
    "compares "
    "them.\nExit status: 0 done, 1 failed, 2 wrong usage, 130 cancelled.";

/// What fails because the user has cancelled is no failure.
int fail(int status, const std::string& text) {
    if (host::Host::cancelRequested()) return kCancelled;
    fmt::print(stderr, "orlith: error: {}\n", text);
    return status;
}

/// Runs the command line; every failure ends here as one line and an exit status.
int run(CLI::App& program, int argc, char** argv, const int& status) {
    try {
        program.parse(argc, argv);
        return status;
    } catch (const CLI::Success& request) {  // --help, --version
        return program.exit(request);
    } catch (const CLI::ParseError& error) {
        return fail(kWrongUsage, error.what());
    } catch (const UsageError& error) {
        return fail(kWrongUsage, error.what());
    } catch (const Cancelled&) {
        return kCancelled;
    } catch (const Orlith::LUT::Exception& exception) {
        return fail(kFailed, exception.message());
    } catch (const std::bad_alloc&) {
        return fail(kFailed, "out of memory");
    } catch (const std::exception& error) {
        return fail(kFailed, error.what());
    }
}

}  // namespace

void warn(const std::string& text) {
    fmt::print(stderr, "orlith: warning: {}\n", text);
}

}  // namespace orlith

int main(int argc, char** argv) {
    orlith::catchInterrupts();

    int status = orlith::kDone;
    CLI::App program(orlith::kDescription, "orlith");
    program.set_version_flag("--version", "orlith " ORLITH_VERSION);
    program.require_subcommand(1);
    orlith::addPattern(program, status);
    orlith::addGenerate(program, status);
    orlith::addConvert(program, status);
    orlith::addInfo(program, status);
    orlith::addEval(program, status);
    orlith::addDiff(program, status);
    orlith::addRun(program, status);
    orlith::addPanel(program, status);
    status = orlith::run(program, argc, argv, status);
    // Results that could not be delivered (a full disk behind a redirection) are a failure.
    if (std::fflush(stdout) != 0 && status == orlith::kDone) {
        std::fputs("orlith: error: standard output cannot be written\n", stderr);
        return orlith::kFailed;
    }
    return status;
}
