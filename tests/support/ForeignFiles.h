#pragma once

#include <string>
#include <vector>

#include "lut/RGB.h"

namespace test {

/// A file as another program writes it, what it means, and what is to be remarked.
struct ForeignFile {
    const char* name;
    std::string text;
    struct Colour {
        Orlith::LUT::RGB in;
        Orlith::LUT::RGB out;
    };
    std::vector<Colour> colours;
    std::vector<std::string> remarks = {};
};

/// Expects files to be read as meant.
void expectLooks(const std::string& extension, const std::vector<ForeignFile>& files);

/// A file that is refused, and the last remark: "LINE: reason".
struct UnreadableFile {
    const char* name;
    std::string text;
    const char* reason;
};

enum class Mode { Book, Meant };

/// Expects files to be refused for their reasons.
void expectReasons(const std::string& extension, Mode mode,
                   const std::vector<UnreadableFile>& files);

/// The remarks on a file, each "LINE: text".
std::vector<std::string> remarksOn(const std::string& extension, Mode mode,
                                   const std::string& text);

}  // namespace test
