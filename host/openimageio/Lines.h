#pragma once

namespace host::openimageio {

/// The lines of an image: triples red, green, blue.
class Lines {
public:
    virtual ~Lines() = default;

    /// @param line  counted from 0; it stands until the next call
    /// @throws Error
    virtual const float* line(int line) = 0;
};

}  // namespace host::openimageio
