#include <cstdlib>
#include <regex>
#include <set>

#include "tests/orlith/Program.h"

namespace {

using UsageTest = test::ProgramTest;

std::set<std::string> longOptions(const std::string& text) {
    const std::regex option("--[a-z][a-z0-9-]*");
    std::set<std::string> found;
    for (std::sregex_iterator each(text.begin(), text.end(), option), end; each != end; ++each)
        found.insert(each->str());
    return found;
}

TEST_F(UsageTest, HelpAndManPageHaveEveryCommandAndOption) {
    EXPECT_EQ(output("--version"), "orlith " ORLITH_TEST_VERSION "\n");
    std::string manual = test::readFile(ORLITH_TEST_MAN_PAGE);
    test::expectIn(manual, "\"orlith " ORLITH_TEST_VERSION "\"");
    manual.erase(manual.find("\n.SH EXAMPLES\n"));  // other programs' options
    manual = std::regex_replace(manual, std::regex(R"(\\-)"), "-");

    const std::string overview = output("--help");
    std::set<std::string> offered = longOptions(overview);
    for (const std::string command :
         {"pattern", "generate", "convert", "info", "eval", "diff", "run", "panel"}) {
        test::expectIn(overview, "\n  " + command + " ");
        test::expectIn(manual, "\n.SS " + command + "\n");
        const std::string help = output(command + " --help");
        test::expectIn(help, "Usage: orlith " + command);
        offered.merge(longOptions(help));
    }
    EXPECT_EQ(longOptions(manual), offered);
}

TEST_F(UsageTest, WrongUsageIsOneLineAndStatusTwo) {
    const struct {
        const char *command, *about;
    } kCases[] = {
        {"", "required"},
        {"generate p.exr", "OUT_LUT"},
        {"info a.cube b.cube", "b.cube"},
        {"info a.cube --jsn", "--jsn"},
        {"pattern p.exr --size 1", "--size"},
        {"generate p.exr o.cube --knob lut1d", "\"lut1d\" has to be NAME=VALUE"},
        {"convert a.cube b.cms --lut1d 1", "--lut1d"},
        {"info a.3dl --read-output-bitdepth 32",
         "has to be detect, input or a number of bits from 1 to 31"},
        {"eval a.cube 0 0 x", "\"x\" is not a number"},
        {"diff a.cube b.cube --tolerance nan", "\"nan\" has to be a number from 0 on"},
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

TEST_F(UsageTest, ResultsThatCannotBeDeliveredAreAFailure) {
    folder_.write("a.cube", "LUT_1D_SIZE 2\n0 0 0\n1 1 1\n");
    const std::string start = "cd '" + folder_.path("") + "' && '" ORLITH_TEST_PROGRAM "' ";
    for (const std::string command : {"info a.cube", "--help"}) {
        const int status = std::system((start + command + " 2>err >/dev/full").c_str());
        EXPECT_EQ(WEXITSTATUS(status), 1) << command;
        EXPECT_EQ(read("err"), "orlith: error: standard output cannot be written\n");
    }
}

}  // namespace
