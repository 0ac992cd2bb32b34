#pragma once

#include <string>

#include "host/ImageCodec.h"

namespace host {

/// Answers for the commonest mistakes in the system's words.
/// @throws Error  there is no such file, or it may not be read
void expectReadableFile(const std::string& path);

/// @throws Error  a file that claims more pixels than it can hold, or none
void expectCredibleSize(const ImageWindow& data, const std::string& path);

}  // namespace host
