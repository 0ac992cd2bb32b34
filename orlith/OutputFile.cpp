#include "orlith/OutputFile.h"

#include <fcntl.h>
#include <fmt/format.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <charconv>
#include <cstdio>
#include <filesystem>
#include <random>
#include <system_error>
#include <vector>

#include "host/Host.h"
#include "lut/io/table/Replacement.h"
#include "orlith/Command.h"

namespace orlith {
namespace {

namespace fs = std::filesystem;

constexpr int kMostLinks = 40;  // as the system's own limit

/// An open file, closed at the end.
class Descriptor {
public:
    explicit Descriptor(int descriptor) : descriptor_(descriptor) {}
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;
    ~Descriptor() {
        if (descriptor_ >= 0) ::close(descriptor_);
    }
    int get() const { return descriptor_; }

private:
    int descriptor_;
};

/// What a path leads to.
struct Target {
    std::string path;     // behind all links, of which the last may lead to nothing yet
    int descriptor = -1;  // where the path names one of the program's open files
    bool isStream = false;
};

/// The number of an open file behind "/dev/stdout", "/dev/fd/3" and the like, or -1.
int openFileBehind(const fs::path& path) {
    const fs::path folder = path.parent_path();
    if (folder != "/proc/self/fd" && folder != "/dev/fd") return -1;
    const std::string number = path.filename().string();
    int descriptor = -1;
    std::from_chars(number.data(), number.data() + number.size(), descriptor);
    return descriptor;
}

Target targetOf(const std::string& path) {
    if (path == "-") return {path, STDOUT_FILENO, true};
    std::error_code failure;
    fs::path target = path;
    for (int link = 0; link < kMostLinks; ++link) {
        // Such a link looks like one to a file, where there is one; its name is not what is meant.
        if (const int descriptor = openFileBehind(target); descriptor >= 0) {
            return {path, descriptor, true};
        }
        const fs::path next = fs::read_symlink(target, failure);
        if (failure) break;
        target = target.parent_path() / next;  // replaced where next is absolute
    }
    const fs::file_status status = fs::status(target, failure);
    const bool isStream =
        fs::exists(status) && !fs::is_regular_file(status) && !fs::is_directory(status);
    return {target.string(), -1, isStream};
}

/// @return 0 or an error number
int copyBytes(int from, int to) {
    std::vector<char> block(std::size_t{256} << 10);
    for (;;) {
        ssize_t held = ::read(from, block.data(), block.size());
        if (held < 0 && errno == EINTR) continue;
        if (held <= 0) return held < 0 ? errno : 0;
        for (const char* at = block.data(); held > 0;) {
            const ssize_t written = ::write(to, at, static_cast<std::size_t>(held));
            if (written < 0 && errno == EINTR) continue;
            if (written <= 0) return written < 0 ? errno : EIO;
            at += written;
            held -= written;
        }
    }
}

}  // namespace

OutputFile::OutputFile(const std::string& path) : name_(path == "-" ? "standard output" : path) {
    if (path.empty()) throw UsageError("the output file has no name");
    const Target target = targetOf(path);
    target_ = target.path;
    isStream_ = target.isStream;
    descriptor_ = target.descriptor;

    std::error_code ignored;
    const fs::path file = target_;
    fs::path folder = file.parent_path();
    if (isStream_) {
        folder = fs::temp_directory_path(ignored);
    } else {
        if (fs::is_symlink(file, ignored)) fail(ELOOP);  // links without end
        if (const int error = Orlith::LUT::whyNotReplaceable(file); error != 0) fail(error);
    }
    makeStage(folder, path == "-" ? "stdout" : file.filename().string());
}

OutputFile::~OutputFile() {
    std::error_code ignored;
    fs::remove_all(stageFolder_, ignored);
    forgetUnfinishedFile();
}

void OutputFile::makeStage(const fs::path& folder, const std::string& fileName) {
    std::random_device random;
    for (;;) {
        stageFolder_ = folder / fmt::format(".orlith-{:08x}", random());
        stagedPath_ = (stageFolder_ / fileName).string();
        // Before it is there: a signal may come at any time.
        setUnfinishedFile(stageFolder_.string(), stagedPath_);
        if (mkdir(stageFolder_.c_str(), 0700) == 0) return;
        if (errno != EEXIST) break;
    }
    const int error = errno;
    forgetUnfinishedFile();
    if (error == ENOENT) {
        throw Failure(fmt::format("{}: there is no folder {}", name_, folder.string()));
    }
    fail(error);
}

void OutputFile::fail(int error) const {
    throw Failure(fmt::format("{}: {}", name_, std::generic_category().message(error)));
}

std::string OutputFile::inWords(std::string text) const {
    for (std::size_t at = 0; (at = text.find(stagedPath_, at)) != std::string::npos;) {
        text.replace(at, stagedPath_.size(), name_);
        at += name_.size();
    }
    return text;
}

std::string OutputFile::whyNotReadBack(bool isUnwanted) const {
    if (isUnwanted) return "--no-verify";
    return isStream_ ? "a pipe or a device is not read back" : "";
}

void OutputFile::print(const std::string& line) const {
    std::fputs(line.c_str(), descriptor_ == STDOUT_FILENO ? stderr : stdout);
}

void OutputFile::expectNotCancelled() const {
    if (host::Host::cancelRequested()) throw Cancelled();
}

void OutputFile::deliver() {
    expectNotCancelled();
    if (isStream_) {
        scope_.release();
        copyToStream();
    } else {
        replaceTarget();
    }
}

void OutputFile::copyToStream() const {
    const Descriptor source(::open(stagedPath_.c_str(), O_RDONLY | O_CLOEXEC));
    if (source.get() < 0) fail(errno);
    // An open one is taken as it stands: what was written to it before is not overwritten.
    const Descriptor stream(descriptor_ >= 0 ? dup(descriptor_)
                                             : ::open(target_.c_str(), O_WRONLY | O_CLOEXEC));
    if (stream.get() < 0) fail(errno);
    if (const int error = copyBytes(source.get(), stream.get()); error != 0) fail(error);
}

void OutputFile::replaceTarget() {
    const int error = Orlith::LUT::prepareReplacement(stagedPath_, target_);
    if (error != 0) fail(error);
    if (!scope_.close()) throw Cancelled();
    if (std::rename(stagedPath_.c_str(), target_.c_str()) != 0) fail(errno);
}

void expectOtherFile(const std::string& output, const std::string& input) {
    std::error_code ignored;
    if (!fs::equivalent(output, input, ignored)) return;
    throw Failure(fmt::format("{}: is read here, and would be replaced", output));
}

bool isStream(const std::string& path) {
    return targetOf(path).isStream;
}

std::string writeFailureReason(int error) {
    const bool isOfWrite = error == ENOSPC || error == EFBIG || error == EDQUOT || error == EIO;
    return isOfWrite ? fmt::format(" ({})", std::generic_category().message(error)) : "";
}

}  // namespace orlith
