#pragma once

#include <filesystem>
#include <string>

#include "orlith/Signals.h"

namespace orlith {

/// The file that a command is going to write: complete under its name in the end, or not there at
/// all. What stood there before stays until then, whatever happens.
///
///     OutputFile output("looks/film.cube");
///     write to output.stagedPath();              looks/.orlith-0a93f1c2/film.cube
///     output.deliver();                          looks/film.cube
///
/// A pipe or a device gets the finished file's bytes instead. While an OutputFile lives, Ctrl-C is
/// a request (see CancelScope), unless interruptAtOnce. Links are followed; the file at their end
/// is replaced, and its permissions are kept.
class OutputFile {
public:
    /// @param path  "-": standard output
    /// @throws Failure  nothing can be written there, with the system's reason
    explicit OutputFile(const std::string& path);
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;
    /// Removes what was not delivered.
    ~OutputFile();

    /// The path as people know it: as it was given, or "standard output".
    const std::string& name() const { return name_; }

    /// Where to write; it has the file's own name and extension.
    const std::string& stagedPath() const { return stagedPath_; }

    /// A text about the staged file as a text about the file.
    std::string inWords(std::string text) const;

    /// Whether the bytes go to a pipe or a device, from which nothing can be read back.
    bool isStream() const { return isStream_; }

    /// Why the file is not read back to be compared; empty if it is.
    /// @param isUnwanted  --no-verify
    std::string whyNotReadBack(bool isUnwanted) const;

    /// Prints a line about the file: on standard output, unless the file itself goes there.
    void print(const std::string& line) const;

    /// @throws Cancelled
    void expectNotCancelled() const;

    /// From here on Ctrl-C ends the program at once, which removes what is unfinished: for work
    /// that would not ask.
    void interruptAtOnce() { scope_.release(); }

    /// Puts the finished file in place. From here on Ctrl-C does not count any more.
    /// @throws Cancelled, Failure  and what stood there before still does
    void deliver();

private:
    void makeStage(const std::filesystem::path& folder, const std::string& fileName);
    void replaceTarget();
    void copyToStream() const;
    [[noreturn]] void fail(int error) const;

    CancelScope scope_;
    std::string name_;
    std::string target_;  // behind all links
    bool isStream_ = false;
    int descriptor_ = -1;  // of a stream that is open already
    std::filesystem::path stageFolder_;
    std::string stagedPath_;
};

/// @throws Failure  what would be written is what is read, and of another kind
void expectOtherFile(const std::string& output, const std::string& input);

/// Whether what is written under that path goes to a pipe or a device.
bool isStream(const std::string& path);

/// Why a file could not be written whole: " (No space left on device)", or an empty text where the
/// error is not one of a write.
/// @param error  errno behind the writing, set to 0 before
std::string writeFailureReason(int error);

}  // namespace orlith
