#pragma once

#include <string>
#include <utility>
#include <vector>

#include "tests/support/Tables.h"

namespace test {

/// The property "interchange".
enum Mode { kBook, kMeant };

/// What comes of a file.
struct Outcome {
    /// The message of a failure; or what the Evaluator gives for colours, "0 1 2 -> .5 .5 1, ...";
    /// or "", a table that does not matter.
    Outcome(const char* text);
    Outcome(const ol::RGB& in, const ol::RGB& out) : colours{{in, out}} {}

    std::vector<std::pair<ol::RGB, ol::RGB>> colours;
    std::string message = "(no exception)";
};

/// A file as another program writes it, and what is made of it.
struct ForeignFile {
    const char* name;
    std::string text;
    Mode mode;
    Outcome outcome;
    std::string remarks = {};  ///< all of them, "LINE: text | LINE: text"
};

/// Reads files with the reader of an extension, and expects all that is said of them.
void expectOutcomes(const std::string& extension, const std::vector<ForeignFile>& files);

/// What the Evaluator gives for a colour.
ol::RGB evaluated(const boost::shared_ptr<const ol::LUT>& table, const ol::RGB& in);

/// "LF" as "CR LF".
std::string withReturns(std::string text);

}  // namespace test
