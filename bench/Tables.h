#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "lut/LUT3D.h"

namespace bench {

/// A smooth film-like look of n points a side, with values of many digits, and a pre-LUT for the
/// formats that want one.
boost::shared_ptr<Orlith::LUT::LUT3D> look(int points);

/// A file of its own for one benchmark, gone with it.
class ScratchFile {
public:
    explicit ScratchFile(const std::string& extension);
    ScratchFile(const ScratchFile&) = delete;
    ScratchFile& operator=(const ScratchFile&) = delete;
    ~ScratchFile();

    const std::string& path() const { return path_; }

private:
    std::string path_;
};

}  // namespace bench
