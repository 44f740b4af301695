#pragma once

#include "LogGenerator/Records/Sample.h"
#include "fields/Reference.h"

#include <cstdint>
#include <map>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Any entry of a list, in the path of a field.
inline constexpr std::string_view kEntryName = "*";

/// One field of a technology, whatever log codes tell it.
struct FieldInfo {
    enum class Kind {
        Number, ///< with a unit, where it has one
        Label,  ///< one of `labels`, or another text
        Text,
        Object, ///< a value or an element of a property list, as it comes
    };

    std::string name; ///< "lte.serving_cell_measurements.measured_rsrp": stable, as filters have it
    /// Where the display shows it: "/Neighbor Cells List/*/Measured RSRP", "*" being any entry.
    std::string path;
    std::string section;
    std::string key; ///< empty where an entry of the list is the value itself
    Kind kind = Kind::Number;
    std::string unit;
    /// Of the number that is shown; nothing where the layout does not limit it.
    std::optional<double> least;
    std::optional<double> most;
    std::string meaning;
    std::vector<std::string> labels;
    std::vector<LogCode> codes;
    bool isInList = false;
    bool identifies = false; ///< its list's entry, with the others of the list that do
    /// The names of the fields of its list that say which cell, pilot or context an entry is;
    /// `kEntryName` where the entry's own name in the path says it.
    std::vector<std::string> identity;
    bool isPersonal = false; ///< identifies a person, a device or a subscription
    bool isShown = true;
    std::vector<FieldId> rows; ///< of the technology's layouts
};

/// Every field of one technology, in the order of its display.
class FieldRegistry {
public:
    explicit FieldRegistry(const TechnologyReference& technology);

    const std::vector<FieldInfo>& fields() const { return _fields; }
    /// The field of a row, or null.
    const FieldInfo* ofRow(FieldId row) const;
    /// The field of that name, or null.
    const FieldInfo* named(std::string_view name) const;

private:
    std::vector<FieldInfo> _fields;
    std::map<FieldId, std::size_t> _byRow;
    std::map<std::string, std::size_t, std::less<>> _byName;
};

/// "Serving Cell Info" as "serving_cell_info": a part of a field's name.
std::string fieldWord(std::string_view text);

} // namespace pallax
