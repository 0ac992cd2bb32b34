#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "lut/io/LUTFileReader.h"
#include "lut/io/LUTFileWriter.h"

namespace Orlith::LUT {

/// Makes a reader for a file's extension. The file itself is not touched.
///
/// @param filename            path; its extension decides, unless one is given
/// @param useGivenExtension   true: take givenExtension, ignore filename
/// @param givenExtension      with its dot, ".csp"; compared exactly, case counts
/// @return    a new reader, shared with nobody yet
/// @throws    Exception  "reader not found" for ".icc";
///                       "No reader found for extension \"%s\"." for any other unknown one,
///                       the %s standing in the text as it is
boost::shared_ptr<LUTFileReader> createReader(const std::string& filename, bool useGivenExtension,
                                              const std::string& givenExtension);

/// Makes a writer; otherwise as createReader, with "writer not found" and
/// "No writer found for extension \"%s\".".
boost::shared_ptr<LUTFileWriter> createWriter(const std::string& filename, bool useGivenExtension,
                                              const std::string& givenExtension);

/// Splits a path at the last dot of its file name: "a.b/look.cube" into "a.b/look" and ".cube".
/// No extension where the name has no dot or starts with its only one; `/`, `\` and `:` end a
/// folder.
/// @param base, extension  where to put the parts; either may be null
void splitExtension(const std::string& path, std::string* base, std::string* extension);

}  // namespace Orlith::LUT
