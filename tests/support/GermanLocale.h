#pragma once

#include <gtest/gtest.h>

#include <clocale>
#include <cstdio>
#include <locale>
#include <sstream>
#include <string>

namespace test {

/// A German process, in C and in C++, as long as this lives: comma before the fraction, points
/// between thousands. The test fails where the locale is not installed.
class GermanLocale {
public:
    GermanLocale() : cLocale_(std::setlocale(LC_ALL, nullptr)) {
        std::locale::global(std::locale("de_DE.UTF-8"));  // sets that of C, too
        char text[16];
        std::snprintf(text, sizeof(text), "%.1f", 0.5);
        EXPECT_STREQ(text, "0,5");
        EXPECT_EQ((std::ostringstream() << 1234.5).str(), "1.234,5");
    }
    GermanLocale(const GermanLocale&) = delete;
    GermanLocale& operator=(const GermanLocale&) = delete;
    ~GermanLocale() {
        std::locale::global(cppLocale_);
        std::setlocale(LC_ALL, cLocale_.c_str());
    }

private:
    std::locale cppLocale_;  // the global one, as it was
    std::string cLocale_;
};

}  // namespace test
