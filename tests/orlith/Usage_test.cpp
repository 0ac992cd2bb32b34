#include <algorithm>
#include <regex>
#include <set>

#include "tests/orlith/Program.h"

namespace {

using test::Words;

class UsageTest : public test::ProgramTest {
protected:
    /// Expects one line "orlith: error: ..." with that in it, the status of wrong usage, no result.
    void expectWrong(const Words& arguments, const std::string& fragment) const {
        SCOPED_TRACE(::testing::PrintToString(arguments));
        const test::Outcome outcome = run(arguments);
        EXPECT_EQ(outcome.status, 2);
        EXPECT_EQ(outcome.out, "");
        EXPECT_EQ(outcome.err.rfind("orlith: error: ", 0), 0U) << outcome.err;
        EXPECT_EQ(std::count(outcome.err.begin(), outcome.err.end(), '\n'), 1) << outcome.err;
        EXPECT_NE(outcome.err.find(fragment), std::string::npos) << outcome.err;
    }
};

const Words kCommands = {"pattern", "generate", "convert", "info", "eval", "diff", "run", "panel"};

std::set<std::string> longOptions(const std::string& text) {
    const std::regex option("--[a-z][a-z0-9-]*");
    std::set<std::string> found;
    for (std::sregex_iterator each(text.begin(), text.end(), option), end; each != end; ++each)
        found.insert(each->str());
    return found;
}

TEST_F(UsageTest, HelpAndManPageHaveEveryCommandAndOption) {
    EXPECT_EQ(output({"--version"}), "orlith " ORLITH_TEST_VERSION "\n");
    const std::string overview = output({"--help"});
    std::string manual = test::readFile(ORLITH_TEST_MAN_PAGE);
    EXPECT_NE(manual.find("\"orlith " ORLITH_TEST_VERSION "\""), std::string::npos);
    manual.erase(manual.find("\n.SH EXAMPLES\n"));  // other programs' options
    manual = std::regex_replace(manual, std::regex(R"(\\-)"), "-");
    const std::set<std::string> described = longOptions(manual);

    std::set<std::string> offered = longOptions(overview);
    for (const std::string& command : kCommands) {
        SCOPED_TRACE(command);
        EXPECT_NE(overview.find("\n  " + command + " "), std::string::npos);
        EXPECT_NE(manual.find("\n.SS " + command + "\n"), std::string::npos);
        const std::string help = output({command, "--help"});
        EXPECT_NE(help.find("Usage: orlith " + command), std::string::npos);
        offered.merge(longOptions(help));
    }
    EXPECT_EQ(described, offered);
}

TEST_F(UsageTest, WrongUsageIsStatusTwo) {
    expectWrong({}, "required");
    expectWrong({"generate", "p.exr"}, "OUT_LUT");
    expectWrong({"info", "a.cube", "b.cube"}, "b.cube");
    expectWrong({"info", "a.cube", "--jsn"}, "--jsn");
    expectWrong({"pattern", "p.exr", "--size", "1"}, "--size");
    expectWrong({"generate", "p.exr", "o.cube", "--knob", "lut1d"},
                "\"lut1d\" has to be NAME=VALUE");
    expectWrong({"convert", "a.cube", "b.3dl", "--format-3dl", "auto"}, "--format-3dl");
    expectWrong({"convert", "a.cube", "b.cms", "--lut1d", "1"}, "--lut1d");
    expectWrong({"info", "a.3dl", "--read-output-bitdepth", "32"},
                "has to be detect, input or a number of bits from 1 to 31");
    expectWrong({"eval", "a.cube", "0", "0", "x"}, "\"x\" is not a number");
    expectWrong({"diff", "a.cube", "b.cube", "--tolerance", "nan"},
                "--tolerance: \"nan\" has to be a number from 0 on");
    EXPECT_FALSE(exists("p.exr"));
}

TEST_F(UsageTest, ResultsThatCannotBeDeliveredAreAFailure) {
    folder_.write("a.cube", "LUT_1D_SIZE 2\n0 0 0\n1 1 1\n");
    const std::string program = ORLITH_TEST_PROGRAM;
    for (const std::string command : {" info a.cube", " --help"}) {
        std::string line = "cd '";
        line.append(folder_.path("")).append("' && '").append(program).append("'");
        line.append(command).append(" 2>err >/dev/full");
        const int status = std::system(line.c_str());
        EXPECT_EQ(WEXITSTATUS(status), 1) << command;
        EXPECT_EQ(read("err"), "orlith: error: standard output cannot be written\n");
    }
}

}  // namespace
