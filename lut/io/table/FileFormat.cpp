#include "lut/io/table/FileFormat.h"

#include <boost/algorithm/string/case_conv.hpp>

#include "lut/io/Registry.h"

namespace Orlith::LUT {

std::string withDot(const std::string& extension) {
    return extension.empty() || extension.front() == '.' ? extension : "." + extension;
}

std::string formatOf(const std::string& path, const std::string& givenExtension) {
    std::string extension = givenExtension;
    if (extension.empty()) splitExtension(path, nullptr, &extension);
    boost::algorithm::to_lower(extension, std::locale::classic());
    return extension;
}

std::string formatProblem(const char* message, const std::string& extension,
                          const std::string& option) {
    std::string text = message;
    if (const std::size_t place = text.find("%s"); place != std::string::npos) {
        text.replace(place, 2, extension);
    }
    return text + " (name the format by " + option + ": 3dl, blut, cms, csp, cub, cube or vf)";
}

}  // namespace Orlith::LUT
