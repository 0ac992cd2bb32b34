// Where results go: whole files or none, pipes and devices, and what signals leave behind.

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <csignal>
#include <cstdlib>

#include "tests/orlith/Program.h"

namespace {

namespace fs = std::filesystem;

class OutputFileTest : public test::ProgramTest {
protected:
    OutputFileTest() {
        test::writePattern(folder_.path("p.exr"), 2);
        folder_.write("a.cube", curve(2));
    }

    static std::string curve(int entries) {
        std::string text = "LUT_1D_SIZE " + std::to_string(entries) + "\n";
        for (int i = 0; i < entries; ++i)
            text += "0.250000 0.500000 0.750000\n";
        return text;
    }

    /// Exit status of a shell command in the folder; $ORLITH is the program.
    int shell(const std::string& command) const {
        const std::string start =
            "cd '" + folder_.path("") + "' && ORLITH='" ORLITH_TEST_PROGRAM "' && { ";
        return WEXITSTATUS(std::system((start + command + "; } >out 2>err").c_str()));
    }

    std::ptrdiff_t fileCount() const {
        return std::distance(fs::directory_iterator(folder_.path("")), {});
    }

    /// Makes a FIFO, starts the program, which is to open it for reading, and presses Ctrl-C once
    /// it has. Then the FIFO gets its contents and its end.
    test::Outcome interruptWhileReading(const std::string& fifo, const std::string& command,
                                        const std::string& contents) const {
        const std::string path = folder_.path(fifo);
        EXPECT_EQ(mkfifo(path.c_str(), 0600), 0);
        test::Program program(folder_.path(""), command);
        const int writing = open(path.c_str(), O_WRONLY);  // waits for the reader
        program.send(SIGINT);
        EXPECT_EQ(::write(writing, contents.data(), contents.size()),
                  static_cast<ssize_t>(contents.size()));
        close(writing);
        return program.wait();
    }
};

TEST_F(OutputFileTest, WhatCannotBeWrittenWholeLeavesTheOldFile) {
    folder_.write("big.cube", curve(4000));
    fs::create_directory(folder_.path("folder.cube"));
    fs::create_symlink("loop.cube", folder_.path("loop.cube"));
    fs::create_symlink("/dev/full", folder_.path("full.cube"));
    const struct {
        const char *command, *file, *about;
    } kCases[] = {
        {"ulimit -f 40; $ORLITH convert big.cube old.csp", "old.csp",
         "not all of the file could be written (File too large)\n"},
        {"ulimit -f 2; $ORLITH pattern old.tif --size 17", "old.tif", ""},
        // The format's writer does not look.
        {"ulimit -f 2; $ORLITH pattern old.sgi --size 17", "old.sgi", "cannot be written whole"},
        {"$ORLITH view a.cube --output a.cube", "a.cube", "is read here"},
        {"$ORLITH generate p.exr p.exr --file-type .cube", "p.exr", "is read here"},
        {"ulimit -f 40; $ORLITH generate p.exr old.cms --lut1d 9000", "old.cms",
         "Error writing LUT file: not all of the file could be written (File too large)\n"},
        {"$ORLITH convert a.cube full.cube", "full.cube", "No space left on device"},
        {"$ORLITH generate p.exr full.cube", "full.cube", "No space left on device"},
        {"$ORLITH convert a.cube folder.cube", "folder.cube", "Is a directory"},
        {"$ORLITH convert a.cube loop.cube", "loop.cube", "Too many levels of symbolic links"},
        {"$ORLITH convert a.cube none/o.cube", "none/o.cube", "there is no folder none"},
    };
    for (const auto& each : kCases) {
        const std::string file = each.file;
        const bool isOld = file.rfind("old", 0) == 0;
        if (isOld) folder_.write(file, "precious");
        EXPECT_EQ(shell(each.command), 1) << each.command;
        EXPECT_EQ(read("out"), "") << each.command;
        const std::string start = "orlith: error: " + file + ": " + each.about;
        EXPECT_EQ(read("err").substr(0, start.size()), start);
        if (isOld) {
            EXPECT_EQ(read(file), "precious") << each.command;
        }
    }
    EXPECT_EQ(fileCount(), 12);
}

TEST_F(OutputFileTest, FollowsLinksAndKeepsPermissions) {
    const auto permissions = [&](const char* name) {
        return fs::status(folder_.path(name)).permissions();
    };
    folder_.write("real.csp", "old");
    fs::permissions(folder_.path("real.csp"), fs::perms(0640));
    fs::create_symlink("real.csp", folder_.path("link.csp"));
    fs::create_symlink("fresh.csp", folder_.path("dangling.csp"));
    for (const std::string name : {"link", "dangling"}) {
        expect("convert a.cube " + name + ".csp --quiet", 0, "", "");
        EXPECT_TRUE(fs::is_symlink(folder_.path(name + ".csp")));
    }
    EXPECT_EQ(permissions("real.csp"), fs::perms(0640));
    EXPECT_EQ(read("real.csp"), read("fresh.csp"));
    EXPECT_EQ(output("convert a.cube a.cube"), "a.cube: .cube, 2 entries, largest deviation 0\n");
    EXPECT_EQ(fileCount(), 6);
}

TEST_F(OutputFileTest, PipesAndDevicesGetTheFile) {
    expect("convert a.cube whole.csp --quiet", 0, "", "");
    const std::string table = read("whole.csp");
    const std::string summary =
        ": .csp, 2 entries, not verified: a pipe or a device is not read back\n";
    const struct {
        const char* command;
        std::string out, err;
    } kCases[] = {
        {"$ORLITH convert a.cube - --to csp | cat", table, "standard output" + summary},
        {"$ORLITH convert a.cube /dev/stdout --to csp | cat", table, "/dev/stdout" + summary},
        {"echo 1; $ORLITH convert a.cube - --to csp --quiet; echo 2", "1\n" + table + "2\n", ""},
        {"$ORLITH convert a.cube /dev/null --to csp", "/dev/null" + summary, ""},
        {"$ORLITH convert - - --from cube --to csp --quiet <a.cube", table, ""},
    };
    for (const auto& each : kCases) {
        EXPECT_EQ(shell(each.command), 0) << each.command;
        EXPECT_EQ(read("out"), each.out) << each.command;
        EXPECT_EQ(read("err"), each.err) << each.command;
    }
}

// Signals.

TEST_F(OutputFileTest, WheneverASignalComesTheFileIsTheOldOrTheNewOne) {
    folder_.write("a.cube", curve(60000));
    expect("convert a.cube o.csp --quiet", 0, "", "");
    const std::string whole = read("o.csp");
    for (int moment = 0; moment < 40; ++moment) {
        folder_.write("o.csp", "precious");
        const int signal = moment % 2 == 0 ? SIGINT : SIGTERM;
        test::Program program(folder_.path(""), "convert a.cube o.csp --quiet");
        usleep(static_cast<useconds_t>(moment) * 1000);
        program.send(signal);
        const int status = program.wait().status;
        EXPECT_TRUE(status == 0 || status == 128 + signal) << status;
        const bool isOld = read("o.csp") == "precious";
        EXPECT_TRUE(isOld || read("o.csp") == whole) << moment;
        EXPECT_FALSE(status == 0 && isOld) << moment;
        EXPECT_FALSE(status == 128 + SIGINT && !isOld) << moment;
    }
    EXPECT_EQ(fileCount(), 3);
}

TEST_F(OutputFileTest, CancelledOperatorsWriteNothing) {
    const test::Outcome outcome =
        interruptWhileReading("saved.tcl", "run saved.tcl --press GenerateLUT1.generate",
                              "Read {file p.exr}\nGenerateLUT {file out.cube}\n");
    EXPECT_EQ(outcome.status, 130);
    EXPECT_EQ(outcome.err, "");
    EXPECT_FALSE(exists("out.cube"));
}

TEST_F(OutputFileTest, CancellingEndsScriptsAndCommandsWithoutOperators) {
    EXPECT_EQ(interruptWhileReading("s.tcl", "run s.tcl", "while 1 {}\n").status, 130);
    EXPECT_EQ(interruptWhileReading("f.cube", "eval f.cube 0 0 0", "").status, 130);
}

}  // namespace
