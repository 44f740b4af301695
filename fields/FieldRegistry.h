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

/// Stands for any entry of a list in the path of a field.
inline constexpr std::string_view kEntryName = "*";

/// One field of a technology, from all its log codes.
struct FieldInfo {
    enum class Kind {
        Number, ///< with a unit, if it has one
        Label,  ///< one of `labels`, or another text
        Text,
        Object, ///< a value or an element of a property list, unchanged
    };

    std::string name; ///< "lte.serving_cell_measurements.measured_rsrp"; stable, for filters
    /// Its place in the display: "/Neighbor Cells List/*/Measured RSRP".
    std::string path;
    std::string section;
    std::string key; ///< empty if an entry of the list is the value itself
    Kind kind = Kind::Number;
    std::string unit; ///< empty if values come without one, or in several
    /// The range of the shown number; nothing if the layout does not limit it.
    std::optional<double> least;
    std::optional<double> most;
    std::string meaning;
    std::vector<std::string> labels;
    std::vector<std::string> otherwise; ///< those of `labels` that say that it has no value
    std::vector<LogCode> codes;
    bool isInList = false;
    bool identifies = false; ///< part of the identity of its list's entries
    /// The names of the fields that form the identity of its list's entries; `kEntryName` if the
    /// entry's name in the path does.
    std::vector<std::string> identity;
    bool isPersonal = false; ///< identifies a person, a device or a subscription
    bool isShown = true;
    std::vector<FieldId> rows; ///< in the technology's layouts
    /// Where a row reads the field.
    struct Place {
        LogCode code;
        bool isInSubpacket;
    };
    std::vector<Place> places; ///< of each row
    /// How its rows show raw numbers, where some have labels.
    std::vector<Conversion> labelled;

    /// The label of a raw number; empty if the number is shown itself, or not at all.
    std::string_view labelOf(std::int64_t raw) const;
};

/// All fields of one technology, in the order of its display.
class FieldRegistry {
public:
    explicit FieldRegistry(const TechnologyReference& technology);

    const std::vector<FieldInfo>& fields() const { return _fields; }
    /// The field of a row, or null.
    const FieldInfo* ofRow(FieldId row) const;
    const FieldInfo* named(std::string_view name) const;

private:
    std::vector<FieldInfo> _fields;
    std::map<FieldId, std::size_t> _byRow;
    std::map<std::string, std::size_t, std::less<>> _byName;
};

/// "number": one word, for tables and programs.
std::string_view kindName(FieldInfo::Kind kind);

/// A part of a field's name: "serving_cell_info" for "Serving Cell Info".
std::string fieldWord(std::string_view text);

} // namespace pallax
