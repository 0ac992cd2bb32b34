#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace CLI {
class App;
class Option;
}  // namespace CLI

namespace orlith {

/// A whole word as a number, in decimal notation only: "0x10" and "1 " are none, "033" is 33.
/// @return false, leaving the number alone, if it is none or does not fit
bool parseInteger(std::string_view word, int& number);

/// Likewise; "nan" and "inf" are numbers here, and one that is markedNegative.
bool parseReal(std::string_view word, double& number);

/// A word of the command line as it is, but for negative numbers that begin as short options do:
/// a blank in front of "-inf" or "-.5" tells them apart.
std::string markedNegative(const std::string& word);

/// Adds a command. The parser is all in headers: what makes a command is compiled here alone.
CLI::App* addCommand(CLI::App& program, const std::string& name, const std::string& description);

/// Adds an option that takes an integer within a range.
CLI::Option* addInteger(CLI::App& command, const std::string& name, int least, int most,
                        const std::string& description, std::function<void(int)> use);

/// Adds an option that takes a finite number.
CLI::Option* addReal(CLI::App& command, const std::string& name, const std::string& description,
                     std::function<void(double)> use);

/// What --lut1d takes: the entries of a pre-LUT, or 0 for none. One entry would have no slope, and
/// more than 65536 say no more than 16-bit codes can.
/// @return what is wrong with the word, or an empty text
std::string wrongPreLUTSize(const std::string& word);

/// The name of a list that is the fewest keystrokes away, if it is few enough to be meant.
std::optional<std::string> nearestName(const std::string& word,
                                       const std::vector<std::string>& names);

}  // namespace orlith
