#pragma once

#include <algorithm>
#include <cstdint>
#include <locale>
#include <sstream>
#include <string>
#include <vector>

namespace Orlith::Property {

/// Kind of a property's values; the tag, not run-time type information, tells kinds apart.
enum class TypeEnum : std::int32_t { Int = 1, Double = 2, String = 3 };

/// A named list of values of one kind.
/// Binary  the order of the virtual functions and data members is fixed: new ones go last.
class Base {
public:
    virtual ~Base() = default;

    /// A new copy on the heap; the caller owns it.
    virtual Base* clone() const = 0;

    /// Values held now.
    virtual std::uint64_t size() const = 0;

    /// All values separated by ",", or the one at index (which is not checked). Integers in
    /// decimal, doubles as "%g", strings as their bytes without quotes.
    virtual std::string toString() const = 0;
    virtual std::string toString(std::uint32_t index) const = 0;

    const std::string name;
    const TypeEnum type;

protected:
    Base(std::string propertyName, TypeEnum propertyType)
        : name(std::move(propertyName)), type(propertyType) {}
    Base(const Base&) = default;
};

template <class T, TypeEnum kType>
class PropertyTemplate : public Base {
public:
    /// @param valueCount  values to begin with, each zero (or an empty text)
    PropertyTemplate(const std::string& propertyName, std::uint64_t valueCount)
        : Base(propertyName, kType), values(valueCount), count(valueCount) {}

    PropertyTemplate(const PropertyTemplate& other)
        : Base(other), values(other.count), count(other.count) {
        const auto kept = static_cast<std::ptrdiff_t>(std::min(other.values.size(), values.size()));
        std::copy(other.values.begin(), other.values.begin() + kept, values.begin());
    }
    PropertyTemplate& operator=(const PropertyTemplate&) = delete;

    PropertyTemplate* clone() const override { return new PropertyTemplate(*this); }

    std::uint64_t size() const override { return values.size(); }

    std::string toString() const override {
        std::string text;
        for (std::uint32_t i = 0; i < values.size(); ++i) {
            if (i > 0) text += ',';
            text += toString(i);
        }
        return text;
    }

    std::string toString(std::uint32_t index) const override {
        std::ostringstream text;
        text.imbue(std::locale::classic());
        text << values[index];
        return text.str();
    }

    std::vector<T> values;
    const std::uint64_t count;  ///< values that the property was made with
};

using IntValues = PropertyTemplate<std::int32_t, TypeEnum::Int>;
using DoubleValues = PropertyTemplate<double, TypeEnum::Double>;
using StringValues = PropertyTemplate<std::string, TypeEnum::String>;

class Int final : public IntValues {
public:
    using IntValues::PropertyTemplate;
};

class Double final : public DoubleValues {
public:
    using DoubleValues::PropertyTemplate;
};

class String final : public StringValues {
public:
    using StringValues::PropertyTemplate;
};

/// A property seen as its kind; null for a null property, another kind, or a size other than
/// valueCount (0 takes any size).
const IntValues* asInt(const Base* property, std::uint64_t valueCount);
IntValues* asInt(Base* property, std::uint64_t valueCount);
const DoubleValues* asDouble(const Base* property, std::uint64_t valueCount);
DoubleValues* asDouble(Base* property, std::uint64_t valueCount);
const StringValues* asString(const Base* property, std::uint64_t valueCount);
StringValues* asString(Base* property, std::uint64_t valueCount);

}  // namespace Orlith::Property
