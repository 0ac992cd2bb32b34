#pragma once

#include <string>
#include <vector>

#include "tests/support/Tables.h"

namespace test {

/// A file, the property "interchange", and what comes of it.
struct MeantFile {
    const char* name;
    std::string text;
    bool isMeant;
    std::string message;  ///< of the failure; empty: there is a table, and
    ol::RGB output;       ///<   this is what the Evaluator gives for the input in common
    std::string remark;   ///< the last one; empty: there is none
};

void expectMeant(const std::string& extension, const ol::RGB& input,
                 const std::vector<MeantFile>& files, const Reading3DL& prepare = {});

/// What the Evaluator gives for a colour.
ol::RGB evaluated(const boost::shared_ptr<const ol::LUT>& lut, const ol::RGB& input);

}  // namespace test
