#include "store/NamedRows.h"

#include "fields/Standing.h"
#include "query/CellFinder.h"
#include "store/NumberText.h"
#include "text/NumberFormat.h"

#include <cmath>

namespace pallax {

namespace {

constexpr const char* kAddField =
    "INSERT INTO fields (name, path, kind, unit, least, most, in_list, identifies, personal, "
    "meaning, shown) VALUES (?1, ?2, ?3, ?4, ?5, ?6, ?7, ?8, ?9, ?10, ?11) ON CONFLICT (name) DO "
    "UPDATE SET path = ?2, kind = ?3, unit = ?4, least = ?5, most = ?6, in_list = ?7, "
    "identifies = ?8, personal = ?9, meaning = ?10, shown = ?11 RETURNING id";

std::string bytesOf(double number) {
    return {static_cast<const char*>(static_cast<const void*>(&number)), sizeof number};
}

} // namespace

void bindAny(Statement& statement, int parameter, const FieldValue& value) {
    if (!std::isnan(value.number)) {
        statement.bind(parameter, static_cast<std::int64_t>(value.number));
    } else if (!value.isEmpty()) {
        statement.bind(parameter, value.text());
    } else {
        statement.bindNull(parameter);
    }
}

NamedRows::NamedRows(StoreConnection& store)
    : _addField(store.prepare(kAddField)),
      _findSite(store.prepare("SELECT id FROM sites WHERE system = ? AND identity = ?")),
      _addSite(store.prepare("INSERT INTO sites (system, identity, code, channel) "
                             "VALUES (?, ?, ?, ?) RETURNING id")),
      _findText(store.prepare("SELECT id FROM texts WHERE text = ? AND raw IS ? AND reason IS ?")),
      _addText(store.prepare("INSERT INTO texts (text, raw, reason) VALUES (?, ?, ?) "
                             "RETURNING id")),
      _format(store.prepare("SELECT format(?, ?)")) {}

std::int64_t NamedRows::field(const FieldInfo& info) {
    const auto [place, isNew] = _fields.try_emplace(info.name, 0);
    if (isNew) {
        const auto flag = [](bool is) { return std::int64_t{is ? 1 : 0}; };
        _addField.bind(1, info.name).bind(2, info.path).bind(3, kindName(info.kind));
        _addField.bind(4, info.unit).bind(5, info.least).bind(6, info.most);
        _addField.bind(7, flag(info.isInList)).bind(8, flag(info.identifies));
        _addField.bind(9, flag(info.isPersonal)).bind(10, info.meaning);
        _addField.bind(11, flag(info.isShown)).step();
        place->second = _addField.integer(0);
        _addField.run();
    }
    return place->second;
}

std::int64_t NamedRows::site(const FoundCell& cell) {
    const std::string_view system = nameOf(cell.system);
    const auto [place, isNew] = _sites.try_emplace(std::string(system) + " " + cell.identity, 0);
    if (isNew) {
        if (_findSite.bind(1, system).bind(2, cell.identity).step()) {
            place->second = _findSite.integer(0);
        } else {
            _addSite.bind(1, system).bind(2, cell.identity);
            bindAny(_addSite, 3, cell.code);
            bindAny(_addSite, 4, cell.channel);
            _addSite.step();
            place->second = _addSite.integer(0);
            _addSite.run();
        }
        _findSite.reset();
    }
    return place->second;
}

std::optional<std::int64_t> NamedRows::text(const FieldInfo& info, const FieldValue& value,
                                            const std::string& format) {
    // The text and its reason follow from these.
    std::string key = info.name + '\n' + format + '\n' + std::to_string(value.raw.value_or(-1)) +
                      (value.raw ? "r" : "") + (value.shown.displayNumber() != nullptr ? "n" : "t");
    const DisplayNumber* shown = value.shown.displayNumber();
    key += shown != nullptr ? printfText(shown->format()) + bytesOf(value.number) : value.text();
    constexpr std::size_t kMostKept = std::size_t{1} << 18U; // the others are asked for again
    if (_texts.size() >= kMostKept) {
        _texts.clear();
    }
    const auto [place, isNew] = _texts.try_emplace(std::move(key));
    if (isNew) {
        const std::string text = value.text();
        const Standing standing = standingOf(info, text, value.number, value.raw);
        if (standing != Standing::Value || shown == nullptr || !isFormatted(value, format, text)) {
            place->second =
                rowOf({text, shown == nullptr ? value.raw : std::nullopt, nameOf(standing)});
        }
    }
    return place->second;
}

/// Whether SQLite writes the number in that format as it is shown.
bool NamedRows::isFormatted(const FieldValue& value, const std::string& format,
                            const std::string& text) {
    _format.bind(1, format);
    const DisplayNumber& shown = *value.shown.displayNumber();
    if (shown.isReal()) {
        _format.bind(2, value.number + 0.0); // the table has no negative zero
    } else {
        _format.bind(2, shown.integer());
    }
    const bool isSame = _format.step() && _format.text(0) == text;
    _format.reset();
    return isSame;
}

std::int64_t NamedRows::rowOf(const Text& text) {
    const auto bindTo = [&](Statement& statement) -> Statement& {
        statement.bind(1, text.text).bind(2, text.raw);
        return text.reason.empty() ? statement.bindNull(3) : statement.bind(3, text.reason);
    };
    std::int64_t row = 0;
    if (bindTo(_findText).step()) {
        row = _findText.integer(0);
        _findText.reset();
    } else {
        bindTo(_addText).step();
        row = _addText.integer(0);
        _addText.run();
    }
    return row;
}

} // namespace pallax
