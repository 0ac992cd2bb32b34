#include <iostream>

#include "lut/Exception.h"
#include "lut/io/Registry.h"

int main(int argc, char** argv) {
    namespace ol = Orlith::LUT;  // the namespace holds a class of its own name: use an alias
    const std::string file = argc > 1 ? argv[1] : "look.cube";
    try {
        const auto look = ol::createReader(file, false, "")->read(file);
        const ol::RGB grey(0.5F, 0.5F, 0.5F);
        std::cout << look->interpolate(grey, ol::Trilinear, true) << '\n';
        ol::createWriter("copy.csp", false, "")->write("copy.csp", look);
    } catch (const ol::Exception& exception) {  // no std::exception
        std::cerr << file << ": " << exception.message() << '\n';
        return 1;
    }
}
