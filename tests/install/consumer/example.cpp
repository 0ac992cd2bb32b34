#include <iostream>

#include "lut/Evaluator.h"
#include "lut/Exception.h"
#include "lut/io/Registry.h"

int main(int argc, char** argv) {
    namespace ol = Orlith::LUT;  // the namespace holds a class of its own name: use an alias
    namespace property = Orlith::Property;
    const std::string file = argc > 1 ? argv[1] : "look.cube";
    try {
        const auto reader = ol::createReader(file, false, "");
        reader->setProperty("interchange", property::makeProperty<property::Int>("interchange", 1));
        const auto look = reader->read(file);

        float colours[] = {0.5F, 0.5F, 0.5F, 2.0F, 0.0F, 0.0F};  // red, green, blue of each
        ol::Evaluator(look).apply(colours, colours, 2);
        for (const float number : colours)
            std::cout << number << ' ';
        std::cout << '\n';
        ol::createWriter("copy.csp", false, "")->write("copy.csp", look);
    } catch (const ol::Exception& exception) {  // no std::exception
        std::cerr << file << ": " << exception.message() << '\n';
        return 1;
    }
}
