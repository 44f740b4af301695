#pragma once

#include "fields/FieldRegistry.h"
#include "plist/PropertyList.h"

#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Some of a technology's fields, chosen by name. "*" in a name stands for any letters, "?" for
/// one.
class FieldSelection {
public:
    FieldSelection(const std::vector<std::string>& names, const FieldRegistry& registry) {
        add(names, registry);
    }
    /// Of the technology of a recording; a snapshot does not tell its own and can have any.
    FieldSelection(const std::vector<std::string>& names, const RecordedTechnology& technology,
                   const Resources& resources);

    /// The first name that no field of any technology has.
    static std::optional<std::string> unknownName(const std::vector<std::string>& names,
                                                  const Resources& resources);

    /// What a display has of the fields, in new containers, with the marks of sorted dictionaries.
    /// Elements of lists keep their places. Null if `display` is.
    PropertyList of(const PropertyList& display) const;

private:
    void add(const std::vector<std::string>& names, const FieldRegistry& registry);
    bool isInside(const std::string& path) const;
    std::optional<PropertyList> valueAt(const PropertyList& value, const std::string& path) const;
    std::optional<PropertyList> elementsOf(const Array& elements, const std::string& path) const;
    std::optional<PropertyList> entriesOf(const Dictionary& entries, const std::string& path) const;

    std::set<std::string> _paths; ///< in the display
};

} // namespace pallax
