#include "lut/property/Property.h"

#include <gtest/gtest.h>

#include <memory>

#include "lut/property/PropertySet.h"

namespace {

using namespace Orlith::Property;

TEST(Property, StartsWithZeros) {
    EXPECT_EQ(Int("i", 3).toString(), "0,0,0");
    EXPECT_EQ(Double("d", 2).toString(), "0,0");
    EXPECT_EQ(String("s", 2).toString(), ",");
    EXPECT_EQ(Int("none", 0).toString(), "");
    EXPECT_EQ(Int("i", 3).size(), 3U);
    EXPECT_EQ(Int("i", 3).count, 3U);
    EXPECT_EQ(String("s", 1).name, "s");
}

TEST(Property, WritesValuesAsTheStreamDefaultDoes) {
    Int integer("i", 2);
    integer.values = {-2147483647 - 1, 1234567};
    EXPECT_EQ(integer.toString(), "-2147483648,1234567");
    Double number("d", 2);
    number.values = {0.1, 2.5};
    EXPECT_EQ(number.toString(), "0.1,2.5");
    EXPECT_EQ(number.toString(1), "2.5");
    number.values = {1234567.0};
    EXPECT_EQ(number.toString(), "1.23457e+06");
    String text("s", 2);
    text.values = {"a", "b,c"};
    EXPECT_EQ(text.toString(), "a,b,c");
    EXPECT_EQ(text.toString(1), "b,c");
}

TEST(Property, IsSeenAsItsKindAndLengthOnly) {
    Int integer("i", 1);
    Double number("d", 1);
    String text("s", 1);
    struct Row {
        Base* property;
        bool isInt, isDouble, isString;
    };
    for (const auto& [property, isInt, isDouble, isString] :
         {Row{&integer, true, false, false}, Row{&number, false, true, false},
          Row{&text, false, false, true}, Row{nullptr, false, false, false}}) {
        const Base* const readOnly = property;
        for (const std::uint64_t length : {0U, 1U}) {
            EXPECT_EQ(asInt(property, length) != nullptr, isInt);
            EXPECT_EQ(asDouble(property, length) != nullptr, isDouble);
            EXPECT_EQ(asString(property, length) != nullptr, isString);
            EXPECT_EQ(asInt(readOnly, length) != nullptr, isInt);
            EXPECT_EQ(asDouble(readOnly, length) != nullptr, isDouble);
            EXPECT_EQ(asString(readOnly, length) != nullptr, isString);
        }
        EXPECT_EQ(asInt(property, 2), nullptr);
        EXPECT_EQ(asDouble(property, 2), nullptr);
        EXPECT_EQ(asString(property, 2), nullptr);
    }
    integer.values.push_back(5);  // the length is what is held now
    EXPECT_EQ(asInt(&integer, 1), nullptr);
    EXPECT_EQ(asInt(&integer, 2), &integer);
}

TEST(Property, ClonesUpToTheCountItWasMadeWith) {
    Int original("pair", 2);
    original.values = {7, 9, 11};
    const std::unique_ptr<Base> copy(original.clone());
    ASSERT_NE(copy.get(), &original);
    EXPECT_EQ(copy->name, "pair");
    EXPECT_EQ(copy->type, TypeEnum::Int);
    ASSERT_NE(asInt(copy.get(), 2), nullptr);
    EXPECT_EQ(copy->toString(), "7,9");
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
    EXPECT_EQ(set.find("Bits")->toString(), "0.5");
    EXPECT_FALSE(set.find("bit"));
}

}  // namespace
