#pragma once

#include "fields/FieldRegistry.h"
#include "plist/PropertyList.h"
#include "timeline/FieldTable.h"

#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// Whether `field` is the name in which "*" stands for any letters and "?" for one.
bool isNamed(const std::string& field, const std::string& name);

/// Some of a technology's fields, chosen by name.
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

/// The fields of one recording that are chosen by name; of an object stream, also those that come
/// later.
class ChosenFields {
public:
    /// Without names, all. The fields must outlive it.
    ChosenFields(std::vector<std::string> names, const FieldTable& fields)
        : _names(std::move(names)), _fields(fields) {}

    bool has(FieldIndex field) {
        while (_isChosen.size() <= field) {
            _isChosen.push_back(isChosen(_fields[static_cast<FieldIndex>(_isChosen.size())].name));
        }
        return _isChosen[field];
    }

private:
    bool isChosen(const std::string& field) const;

    std::vector<std::string> _names;
    const FieldTable& _fields;
    std::vector<bool> _isChosen; ///< by field, as far as it was asked
};

} // namespace pallax
