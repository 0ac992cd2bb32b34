#include "tests/support/Files.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <fstream>
#include <iterator>

namespace test {

TempFolder::TempFolder() {
    std::string pattern = (std::filesystem::temp_directory_path() / "orlith-test-XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) throw std::runtime_error("no temporary folder");
    folder_ = pattern;
}

TempFolder::~TempFolder() {
    std::error_code ignored;
    std::filesystem::remove_all(folder_, ignored);
}

std::string TempFolder::write(const std::string& name, std::string_view bytes) const {
    std::string file = path(name);
    std::ofstream(file, std::ios::binary) << bytes;
    return file;
}

std::string readFile(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    EXPECT_TRUE(file) << path;
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

std::string dataPath(const std::string& name) {
    return std::string(ORLITH_TEST_DATA) + "/" + name;
}

std::string replaced(std::string text, std::string_view from, std::string_view to) {
    const std::size_t at = text.find(from);
    EXPECT_NE(at, std::string::npos) << "not in the sample: " << from;
    if (at != std::string::npos) text.replace(at, from.size(), to);
    return text;
}

}  // namespace test
