#pragma once

#include "plist/PropertyList.h"

#include <string_view>

namespace pallax {

/// The preferences store: one set of keys per application domain.
class Preferences {
public:
    virtual ~Preferences() = default;
    virtual void setValue(std::string_view key, const PropertyList& value,
                          std::string_view domain) = 0;
    /// Writes the domain's values to permanent storage; false on failure.
    virtual bool synchronize(std::string_view domain) = 0;
    /// Notifies listeners that the key has changed.
    virtual void postChangedNotice(std::string_view domain, std::string_view key) = 0;
};

} // namespace pallax
