#include "lut/property/Property.h"

#include <gtest/gtest.h>

#include <memory>

#include "lut/property/PropertySet.h"
#include "tests/support/GermanLocale.h"

namespace {

using namespace Orlith::Property;

/// A property of these values.
template <class Kind, class Value>
Kind holding(const std::vector<Value>& values) {
    Kind property("name", values.size());
    property.values = values;
    return property;
}

TEST(Property, WritesValuesAsTheStreamDefaultDoesInEveryLocale) {
    const test::GermanLocale locale;
    const auto integer = holding<Int, std::int32_t>({-2147483647 - 1, 1234567});
    EXPECT_EQ(integer.toString(), "-2147483648,1234567");
    const auto number = holding<Double, double>({0.1, 12345.5, 1234567.0});
    EXPECT_EQ(number.toString(), "0.1,12345.5,1.23457e+06");
    EXPECT_EQ(number.toString(1), "12345.5");
    const auto text = holding<String, std::string>({"a", "b,c"});
    EXPECT_EQ(text.toString(), "a,b,c");
    EXPECT_EQ(text.toString(1), "b,c");
}

TEST(Property, IsSeenAsItsKindAndLengthOnly) {
    Int integer("i", 1);
    Double number("d", 1);
    String text("s", 1);
    for (Base* const property : {static_cast<Base*>(&integer), static_cast<Base*>(&number),
                                 static_cast<Base*>(&text), static_cast<Base*>(nullptr)}) {
        for (const std::uint64_t length : {0U, 1U, 2U}) {
            const Base* const fitting = length < 2 ? property : nullptr;
            EXPECT_EQ(asInt(property, length), fitting == &integer ? fitting : nullptr);
            EXPECT_EQ(asDouble(property, length), fitting == &number ? fitting : nullptr);
            EXPECT_EQ(asString(property, length), fitting == &text ? fitting : nullptr);
        }
    }
    integer.values.push_back(5);  // the length is what is held now
    EXPECT_EQ(asInt(&integer, 1), nullptr);
    EXPECT_EQ(asInt(&integer, 2), &integer);
}

TEST(Property, ClonesUpToTheCountItWasMadeWith) {
    Int original("pair", 2);
    original.values = {7, 9, 11};
    const std::unique_ptr<Base> copy(original.clone());
    EXPECT_EQ(copy->name, "pair");
    EXPECT_NE(asInt(copy.get(), 2), nullptr);
    original.values = {8};
    EXPECT_EQ(std::unique_ptr<Base>(original.clone())->toString(), "8,0");
    EXPECT_EQ(copy->toString(), "7,9");
}

TEST(PropertySet, KeepsTheFirstOfAName) {
    PropertySet set;
    EXPECT_TRUE(set.insert("bits", makeProperty<Int>("bits", 10)));
    EXPECT_FALSE(set.insert("bits", makeProperty<Int>("bits", 12)));
    EXPECT_TRUE(set.insert("Bits", makeProperty<Double>("Bits", 0.5)));
    EXPECT_EQ(set.find("bits")->toString(), "10");
    EXPECT_FALSE(set.find("bit"));
}

}  // namespace
