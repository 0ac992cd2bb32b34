#include <cstdio>
#include <cstdlib>
#include <map>
#include <regex>
#include <set>

#include "tests/orlith/Program.h"

namespace {

using UsageTest = test::ProgramTest;

std::set<std::string> all(const std::string& text, const std::regex& what) {
    std::set<std::string> found;
    for (std::sregex_iterator each(text.begin(), text.end(), what), end; each != end; ++each)
        found.insert(each->str(1));
    return found;
}

std::set<std::string> longOptions(const std::string& text) {
    return all(text, std::regex("(--[a-z][a-z0-9-]*)"));
}

std::set<std::string> words(const std::string& text) {
    return all(text, std::regex("([^ ,|\\n]+)"));
}

/// The values of options that have a menu.
/// @param menu  matches an option and its values
std::map<std::string, std::set<std::string>> menus(const std::string& text,
                                                   const std::regex& menu) {
    std::map<std::string, std::set<std::string>> found;
    for (std::sregex_iterator each(text.begin(), text.end(), menu), end; each != end; ++each)
        found[each->str(1)] = words(each->str(2));
    return found;
}

/// What a script of ours prints, run by its shell.
std::string shellOutput(const std::string& command) {
    FILE* const pipe = popen(command.c_str(), "r");
    std::string text;
    for (int byte = 0; pipe != nullptr && (byte = std::fgetc(pipe)) != EOF;)
        text.push_back(static_cast<char>(byte));
    EXPECT_EQ(pipe == nullptr ? -1 : pclose(pipe), 0) << command;
    return text;
}

TEST_F(UsageTest, HelpAndManPageHaveEveryCommandAndOption) {
    EXPECT_EQ(output("--version"), "orlith " ORLITH_TEST_VERSION "\n");
    std::string manual = test::readFile(ORLITH_TEST_MAN_PAGE);
    test::expectIn(manual, "\"orlith " ORLITH_TEST_VERSION "\"");
    manual.erase(manual.find("\n.SH EXAMPLES\n"));  // other programs' options
    manual = std::regex_replace(manual, std::regex(R"(\\-)"), "-");

    const std::string overview = output("--help");
    std::set<std::string> offered = longOptions(overview);
    for (const std::string command : {"pattern", "generate", "bake", "apply", "convert", "info",
                                      "eval", "diff", "view", "run", "panel"}) {
        test::expectIn(overview, "\n  " + command + " ");
        test::expectIn(manual, "\n.SS " + command + "\n");
        const std::string help = output(command + " --help");
        test::expectIn(help, "Usage: orlith " + command);
        offered.merge(longOptions(help));
    }
    EXPECT_EQ(longOptions(manual), offered);
}

TEST_F(UsageTest, CompletionOffersEveryCommandOptionAndMenu) {
    for (const char* const file : {"look.CUBE", "look.exr", "look.tcl", "look.txt"})
        folder_.write(file, "");
    const auto bash = [&](const std::string& line) {
        return words(shellOutput("cd '" + folder_.path("") +
                                 "' && bash '" ORLITH_TEST_COMPLETION
                                 "/offers.bash' '" ORLITH_COMPLETION "/orlith.bash' orlith " +
                                 line));
    };
    const auto zsh = [](const std::string& command) {
        return shellOutput("zsh -f '" ORLITH_TEST_COMPLETION "/offers.zsh' '" ORLITH_COMPLETION
                           "/_orlith' " +
                           command);
    };
    const std::regex helpMenu(R"((--[a-z0-9-]+) [A-Z]*:\{?([a-z0-9,|]+))");
    const std::regex zshMenu(R"((--[a-z0-9-]+)=?\[[^\]]*\]:[^:]*:\(([^)]*)\))");

    const std::string overview = output("--help");
    std::set<std::string> commands =
        all(overview.substr(overview.find("Subcommands:")), std::regex("\n  ([a-z]+) "));
    EXPECT_EQ(all(zsh(""), std::regex("([a-z]+):.*\n")), commands);
    for (const std::string& command : commands) {
        const std::string help = output(command + " --help");
        const std::string told = zsh(command);
        std::set<std::string> options = longOptions(help);
        EXPECT_EQ(longOptions(told), options) << command;
        options.insert("-h");
        EXPECT_EQ(bash(command + " -"), options) << command;
        auto zshMenus = menus(told, zshMenu);
        for (const auto& [option, values] : menus(help, helpMenu)) {
            std::string line = command;
            line.append(" ").append(option);
            EXPECT_EQ(zshMenus[option], values) << line;
            EXPECT_EQ(bash(line + " ''"), values) << line;
        }
    }

    commands.merge(std::set<std::string>{"-h", "--help", "--version"});
    const struct {
        const char* line;
        std::set<std::string> offered;
    } kCases[] = {
        {"''", commands},
        {"con", {"convert"}},
        {"pattern l", {"look.exr"}},
        {"generate look.exr l", {"look.CUBE", "look.exr"}},
        {"info --from cub", {"cub", "cube"}},
        {"diff look.CUBE ''", {"look.CUBE"}},
        {"run ''", {"look.tcl"}},
        {"run look.tcl --press ''", {}},
        {"panel ''", {}},
    };
    for (const auto& each : kCases)
        EXPECT_EQ(bash(each.line), each.offered) << each.line;
}

TEST_F(UsageTest, WrongUsageIsOneLineAndStatusTwo) {
    const struct {
        const char *command, *about;
    } kCases[] = {
        {"", "a command is needed (see orlith --help)"},
        {"covnert", "unknown command \"covnert\"; did you mean \"convert\"? (see orlith --help)"},
        {"xyzzy", "unknown command \"xyzzy\" (see"},
        {"--hepl", "unknown option \"--hepl\"; did you mean \"--help\"?"},
        {"generate p.exr", "OUT_LUT"},
        {"info a.cube b.cube", "b.cube"},
        {"info a.cube --jsn", "unknown option \"--jsn\"; did you mean \"--json\"?"},
        {"pattern p.exr --size 1", "--size"},
        {"generate p.exr o.cube --knob lut1d", "\"lut1d\" has to be NAME=VALUE"},
        {"pattern p.exr --size 0x10", "has to be a whole number from 2 to 129"},
        {"pattern -", "an image goes to a file"},
        {"bake o.cube", "there is nothing to bake: give tables (--lut), or -- PROGRAM, or both"},
        {"bake o.cube -- cp p.exr {out}", "{in} is missing behind --"},
        {"bake o.cube --size 130 -- cp {in} {out}", "a pattern has at most 129 points a side"},
        {"bake o.cube cp {in} {out}", "(see orlith --help and orlith bake --help)"},
        {"bake o.cube --lut - --lut -", "only one of the tables can come from standard input"},
        {"convert a.cube b.cms --lut1d 1", "\"1\" has to be 0 (none) or a whole number"},
        {"generate p.exr o.cms --lut1d 65537", "from 2 to 65536"},
        {"convert a.cube b.3dl --scale nan", "\"nan\" has to be a number"},
        {"eval - --from cube", "cannot both come from standard input"},
        {"diff - - --from cube", "only one of the tables"},
        {"view - - --from cube", "only one of the tables"},
        {"view a.cube b.cube c.cube", "c.cube"},
        {"info a.3dl --read-output-bitdepth 32",
         "has to be detect, input or a number of bits from 1 to 31"},
        {"apply a.exr b.exr", "--lut is required"},
        {"apply a.exr - --lut a.cube", "an image goes to a file"},
        {"apply a.exr b.exr --lut - --lut -", "only one of the tables"},
        {"apply a.#.exr b.#.exr --lut a.cube --frames 5-1",
         "\"5-1\" has to be one run of frames from A up to B"},
        {"apply a.#.exr b.#.exr --lut a.cube --frames 1-5x0", "such as 1-100 or 1-100x2"},
        {"apply a.#.exr b.exr --lut a.cube --frames 1-5", "\"b.exr\" has to have a place"},
        {"apply a.%4.exr b.#.exr --lut a.cube --frames 1-5", "\"a.%4.exr\" has to have a place"},
        {"eval a.cube 0 0 x", "\"0 0 x\" is not three numbers"},
        {"diff a.cube b.cube --tolerance nan", "\"nan\" has to be a number"},
    };
    for (const auto& each : kCases) {
        const test::Outcome outcome = run(each.command);
        EXPECT_EQ(outcome.status, 2) << each.command;
        EXPECT_EQ(outcome.out, "") << each.command;
        EXPECT_EQ(outcome.err.rfind("orlith: error: ", 0), 0U) << outcome.err;
        EXPECT_EQ(outcome.err.find('\n'), outcome.err.size() - 1) << outcome.err;
        test::expectIn(outcome.err, each.about);
    }
    EXPECT_FALSE(exists("p.exr"));
}

TEST_F(UsageTest, TheExitStatusCountsWhateverTheStreamsAre) {
    folder_.write("a.cube", "LUT_1D_SIZE 2\n0 0 0\n1 1 1\n");
    const struct {
        const char* command;
        int status;
        const char* err;
    } kCases[] = {
        {"info a.cube 2>err >/dev/full", 1,
         "orlith: error: standard output cannot be written: No space left on device\n"},
        {"--help 2>err >/dev/full", 1,
         "orlith: error: standard output cannot be written: No space left on device\n"},
        {"info a.cube 2>err >&-", 1,
         "orlith: error: standard output cannot be written: Bad file descriptor\n"},
        {"info none.cube 2>/dev/full; s=$?; : >err; exit $s", 1, ""},
        {"convert none 2>&-; s=$?; : >err; exit $s", 2, ""},
        // Nothing that is said gets into what is written.
        {"convert a.cube b.csp --no-verify >&- 2>&-; grep -q '^CSP' b.csp 2>err", 0, ""},
    };
    const std::string start = "cd '" + folder_.path("") + "' && '" ORLITH_TEST_PROGRAM "' ";
    for (const auto& each : kCases) {
        const int status = std::system((start + each.command).c_str());
        EXPECT_EQ(WEXITSTATUS(status), each.status) << each.command;
        EXPECT_EQ(read("err"), each.err) << each.command;
    }
}

TEST_F(UsageTest, NamesKeepToTheirLine) {
    expect("info a\x1b[2J\n.cube", 1, "",
           "orlith: error: a\\x1b[2J\\n.cube: No such file or directory\n");
}

}  // namespace
