#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace test {

/// A folder of its own for one test, gone with it.
class TempFolder {
public:
    TempFolder();
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;
    ~TempFolder();

    std::string path(const std::string& name) const { return (folder_ / name).string(); }

    /// Makes a file of these bytes and returns its path.
    std::string write(const std::string& name, std::string_view bytes) const;

private:
    std::filesystem::path folder_;
};

/// All bytes of a file; the test fails if it cannot be opened.
std::string readFile(const std::string& path);

/// Path of a file under tests/data.
std::string dataPath(const std::string& name);

/// The text with its only occurrence of `from` replaced; the test fails if it is not there.
std::string replaced(std::string text, std::string_view from, std::string_view to);

}  // namespace test
