#pragma once

#include "store/StoreConnection.h"
#include "timeline/CurrentValues.h"

#include <cstdint>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

namespace pallax {

struct FieldInfo;
struct FoundCell;

/// Binds a part of a cell's identity: a number, a text or nothing.
void bindAny(Statement& statement, int parameter, const FieldValue& value);

/// The rows that intervals of many recordings refer to: fields, serving cells and texts. Each is
/// there once. Only for one transaction.
class NamedRows {
public:
    explicit NamedRows(StoreConnection& store);

    /// The number of the field's row, which is made or brought up to date.
    std::int64_t field(const FieldInfo& info);
    std::int64_t site(const FoundCell& cell);
    /// The number of the text's row; nothing if the text is the number in that format.
    std::optional<std::int64_t> text(const FieldInfo& info, const FieldValue& value,
                                     const std::string& format);

private:
    struct Text {
        std::string text;
        std::optional<std::int64_t> raw;
        std::string_view reason;
    };

    bool isFormatted(const FieldValue& value, const std::string& format, const std::string& text);
    std::int64_t rowOf(const Text& text);

    Statement _addField;
    Statement _findSite;
    Statement _addSite;
    Statement _findText;
    Statement _addText;
    Statement _format;
    std::unordered_map<std::string, std::int64_t> _fields;
    std::unordered_map<std::string, std::int64_t> _sites;
    std::unordered_map<std::string, std::optional<std::int64_t>> _texts; ///< by all that they need
};

} // namespace pallax
