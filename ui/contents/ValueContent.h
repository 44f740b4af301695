#pragma once

#include "overview/ValueFacts.h"
#include "ui/contents/ShownValues.h"

#include <chrono>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// "a, b".
std::string joinedBy(std::string_view between, const std::vector<std::string>& parts);

/// What a page says about the value at a path of the display. Once its field is found, the page
/// stays with that field and entry, wherever its entry stands.
class ValueContent {
public:
    /// `shown` must outlive the object.
    ValueContent(ShownValues& shown, std::string path);

    /// Turns to the instant that is shown now, with curves of this time (nothing: all time).
    /// `rowText` is the text of the row, if there is one, for a value that belongs to no field.
    void update(std::optional<std::chrono::seconds> span, std::optional<std::string> rowText);

    /// Nothing until the field is found.
    const std::optional<LeafName>& leaf() const { return _leaf; }
    /// Null if the value belongs to no field.
    const FieldInfo* field() const { return _field; }
    const ValueFacts& facts() const { return _facts; }
    /// The latest text, also if there is no value now.
    const std::string& text() const { return _text; }
    /// "2 s old"; empty if there is no value now.
    std::string age() const;
    bool hasCurve() const { return _hasCurve; }
    /// Its meaning, what else is known, where it is from and its range, each in one line or empty;
    /// `between` stands between the parts of a line.
    std::vector<std::string> factLines(std::string_view between) const;
    /// The names that lead to it: section, identity of the entry, field.
    std::vector<std::string> place() const;

private:
    ShownValues& _shown;
    std::string _path;
    std::optional<LeafName> _leaf;
    const FieldInfo* _field = nullptr;
    ValueFacts _facts;
    std::string _text;
    std::optional<Time> _read;
    bool _hasCurve = false;
};

} // namespace pallax
