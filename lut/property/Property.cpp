#include "lut/property/Property.h"

namespace Orlith::Property {
namespace {

template <class Kind, TypeEnum kType, class AnyBase>
Kind* as(AnyBase* property, std::uint64_t valueCount) {
    if (property == nullptr || property->type != kType) return nullptr;
    if (valueCount != 0 && property->size() != valueCount) return nullptr;
    return static_cast<Kind*>(property);
}

}  // namespace

const IntValues* asInt(const Base* property, std::uint64_t valueCount) {
    return as<const IntValues, TypeEnum::Int>(property, valueCount);
}

IntValues* asInt(Base* property, std::uint64_t valueCount) {
    return as<IntValues, TypeEnum::Int>(property, valueCount);
}

const DoubleValues* asDouble(const Base* property, std::uint64_t valueCount) {
    return as<const DoubleValues, TypeEnum::Double>(property, valueCount);
}

DoubleValues* asDouble(Base* property, std::uint64_t valueCount) {
    return as<DoubleValues, TypeEnum::Double>(property, valueCount);
}

const StringValues* asString(const Base* property, std::uint64_t valueCount) {
    return as<const StringValues, TypeEnum::String>(property, valueCount);
}

StringValues* asString(Base* property, std::uint64_t valueCount) {
    return as<StringValues, TypeEnum::String>(property, valueCount);
}

}  // namespace Orlith::Property
