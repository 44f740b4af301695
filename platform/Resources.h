#pragma once

#include "plist/PropertyList.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The property-list files of the installation.
class Resources {
public:
    virtual ~Resources() = default;
    /// The resource `name` + ".plist"; nothing if it is missing or cannot be read.
    virtual std::optional<PropertyList> propertyList(std::string_view name) const = 0;
    /// The paths of all resources of type "plist", in any subdirectory, sorted.
    virtual std::vector<std::string> propertyListPaths() const = 0;
};

} // namespace pallax
