#pragma once

#include <OpenImageIO/imageio.h>

#include <string>

namespace host::openimageio {

/// Asks for one of kSampleTypes in what is going to be written.
void setSampleType(OIIO::ImageSpec& spec, const std::string& type);

/// Which of kSampleTypes a file has; empty: none of them.
std::string sampleTypeOf(const OIIO::ImageSpec& spec);

/// The largest code of an integer type that the library makes of 16 bits, which loses what is to be
/// rounded; 0 for the others.
int codeMaxOf(const std::string& type);

/// Makes sure that the format of a file name holds a sample type, by writing and reading a few
/// pixels elsewhere: the library takes the nearest that the format has, and does not say so.
/// @throws Error  with the types that the format holds; the folder for temporary files and why
///                nothing can be written there
void expectFormatHolds(const std::string& path, const std::string& type);

}  // namespace host::openimageio
