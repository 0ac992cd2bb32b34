// What becomes of a table when the system does not take all of its file.

#include "lut/io/OutputFile.h"

#include <gtest/gtest.h>
#include <sys/resource.h>

#include <csignal>
#include <string>

#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"
#include "tests/support/ThreeDL.h"

namespace {

using namespace test;

/// Files end at a size while this object lives: a write that reaches it is a short one.
class FileSizeLimit {
public:
    explicit FileSizeLimit(std::size_t byteCount) : signal_(std::signal(SIGXFSZ, SIG_IGN)) {
        getrlimit(RLIMIT_FSIZE, &before_);
        const rlimit limit{byteCount, before_.rlim_max};
        EXPECT_EQ(setrlimit(RLIMIT_FSIZE, &limit), 0);
    }
    FileSizeLimit(const FileSizeLimit&) = delete;
    FileSizeLimit& operator=(const FileSizeLimit&) = delete;
    ~FileSizeLimit() {
        setrlimit(RLIMIT_FSIZE, &before_);
        std::signal(SIGXFSZ, signal_);
    }

private:
    rlimit before_{};
    void (*signal_)(int);
};

TEST(OutputFile, IsKnownNotToBeWhole) {
    const auto lut = markedLattice(17, 17, 17);
    lut->outputShaper.entries.assign(3, ol::RGB(0.5F, 0.5F, 0.5F));
    const TempFolder folder;
    const std::string path = folder.path("out");
    for (const char* const format : {".3dl", ".blut", ".cms", ".csp", ".cub", ".cube", ".vf"}) {
        for (const int flushLines : {0, 1}) {
            SCOPED_TRACE(std::string(format) + " " + std::to_string(flushLines));
            const auto writer = ol::createWriter("", true, format);
            Writing3DL{"flame"}(*writer);
            setProperty<Orlith::Property::Int>(*writer, "flushLines", flushLines);
            EXPECT_FALSE(writer->wroteAll()) << "nothing was written yet";
            writer->write(path, lut);
            EXPECT_TRUE(writer->wroteAll());
            const std::string whole = readFile(path);
            {
                const FileSizeLimit limit(whole.size() / 2 + 1);
                writer->write(path, lut);
            }
            EXPECT_FALSE(writer->wroteAll());
            EXPECT_TRUE(readFile(path) == whole.substr(0, whole.size() / 2 + 1));
            writer->write(path, lut);
            EXPECT_TRUE(writer->wroteAll());
            writer->write("/dev/full", lut);
            EXPECT_FALSE(writer->wroteAll());
        }
    }
}

}  // namespace
