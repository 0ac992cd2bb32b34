#pragma once

#include <string>
#include <vector>

namespace orlith {

/// Makes sure that a program's words name both images.
/// @throws UsageError
void expectImageWords(const std::vector<std::string>& words);

/// Runs a program that makes an image of an image, to its end. What it prints goes to standard
/// error as it comes; on a terminal a line says for how long it has been running.
///
/// @param words       the program and its arguments, in which {in} and {out} stand for the images
/// @param in, out     their paths
/// @throws Failure    it cannot be run, or fails: how, and its last words
/// @throws Cancelled  and it is ended
void runImageProgram(const std::vector<std::string>& words, const std::string& in,
                     const std::string& out);

}  // namespace orlith
