#pragma once

#include <boost/smart_ptr/make_shared.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <map>
#include <string>

#include "lut/property/Property.h"

namespace Orlith::Property {

/// Properties by name, in the byte order of the names.
class PropertySet {
public:
    /// Stores a property under a name that is still free.
    /// @return false if the name was taken; what it had stays
    bool insert(const std::string& name, const boost::shared_ptr<Base>& property) {
        return properties_.emplace(name, property).second;
    }

    /// The property of that name, or an empty pointer.
    boost::shared_ptr<Base> find(const std::string& name) const {
        const auto found = properties_.find(name);
        return found == properties_.end() ? boost::shared_ptr<Base>() : found->second;
    }

private:
    std::map<std::string, boost::shared_ptr<Base>> properties_;
};

/// A property of one value, ready to be handed to a reader or writer.
template <class Kind, class Value>
boost::shared_ptr<Base> makeProperty(const std::string& name, const Value& value) {
    auto property = boost::make_shared<Kind>(name, 1U);
    property->values[0] = value;
    return property;
}

}  // namespace Orlith::Property
