#pragma once

#include <string>

namespace orlith {

/// A string; a byte of a file name that is no UTF-8 becomes the replacement character.
std::string jsonText(const std::string& text);

/// The shortest digits that give the same float; JSON has no numbers for what is not finite.
std::string jsonNumber(float number);

std::string jsonTriple(const float* rgb);

}  // namespace orlith
