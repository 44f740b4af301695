#include "overview/Differences.h"

#include "text/Format.h"
#include "timeline/Changes.h"

#include <algorithm>
#include <map>
#include <utility>

namespace pallax {

namespace {

/// The unit of a value: that in its text, if it is a number with a unit, or else the field's.
std::string unitOf(const FieldInfo& field, const FieldValue& value) {
    const std::string text = value.text();
    const auto number = numberTextIn(text);
    return number && !number->unit.empty() ? std::string(number->unit) : field.unit;
}

std::size_t decimalsOf(const std::string& text) {
    const std::size_t point = text.find('.');
    if (point == std::string::npos) {
        return 0;
    }
    const std::size_t end = text.find_first_not_of("0123456789", point + 1);
    return std::min(end, text.size()) - point - 1;
}

std::optional<Difference::Amount> amountOf(const Difference& difference) {
    const FieldValue& before = difference.before;
    const FieldValue& after = difference.after;
    std::string unit = unitOf(*difference.field, after);
    if (!std::isfinite(before.number) || !std::isfinite(after.number) || unit.empty() ||
        unit != unitOf(*difference.field, before)) {
        return std::nullopt;
    }
    if (unit == "dBm") {
        unit = "dB";
    }
    const double number = after.number - before.number;
    const auto decimals = std::max(decimalsOf(before.text()), decimalsOf(after.text()));
    const std::string format = "%+." + std::to_string(decimals) + "f %@";
    return Difference::Amount{number, formatText(format, {number, unit}), unit};
}

void add(std::vector<Difference>& differences, Difference difference) {
    difference.amount = amountOf(difference);
    differences.push_back(std::move(difference));
}

std::vector<Difference> differencesOf(const std::vector<Change>& changes,
                                      const CurrentValues& values) {
    std::vector<Difference> differences;
    for (const Change& change : changes) {
        const auto kind = change.kind == Change::Kind::Added     ? Difference::Kind::New
                          : change.kind == Change::Kind::Removed ? Difference::Kind::Gone
                                                                 : Difference::Kind::Changed;
        add(differences,
            {kind, &values.fields()[change.field], values.entries().words(change.entry),
             change.before, change.after, std::nullopt});
    }
    return differences;
}

/// Values by names. What is outside lists is an entry without words, which is always there.
class NamedValues {
public:
    struct Entry {
        std::string words;
        std::vector<std::pair<const FieldInfo*, FieldValue>> values = {};

        const FieldValue* find(std::string_view field) const {
            const auto found =
                std::find_if(values.begin(), values.end(),
                             [field](const auto& each) { return each.first->name == field; });
            return found != values.end() ? &found->second : nullptr;
        }
    };

    explicit NamedValues(const CurrentValues& values) : _entries{{"", {}}}, _places{{"", 0}} {
        const FieldTable& fields = values.fields();
        for (FieldIndex field = 0; field < values.fieldCount(); ++field) {
            if (const FieldValue* value = values.value(field)) {
                _entries.front().values.emplace_back(&fields[field], *value);
            }
        }
        values.forEachEntry([&](const EntryValues& entry) {
            if (entry.values.empty()) {
                return;
            }
            Entry named{values.entries().words(entry.entry)};
            for (const auto& [field, value] : entry.values) {
                named.values.emplace_back(&fields[field], value);
            }
            _places.emplace(keyOf(named), _entries.size());
            _entries.push_back(std::move(named));
        });
    }

    const std::vector<Entry>& entries() const { return _entries; }
    /// The same entry here, or null.
    const Entry* sameAs(const Entry& entry) const {
        const auto found = _places.find(keyOf(entry));
        return found != _places.end() ? &_entries[found->second] : nullptr;
    }

private:
    /// The words, and the list: entries of different lists can have the same words.
    static std::string keyOf(const Entry& entry) {
        if (entry.words.empty()) {
            return "";
        }
        const std::string& path = entry.values.front().first->path;
        return path.substr(0, path.rfind(kEntryName)) + "\n" + entry.words;
    }

    std::vector<Entry> _entries;
    std::map<std::string, std::size_t> _places;
};

void addAll(const NamedValues::Entry& entry, Difference::Kind kind,
            std::vector<Difference>& differences) {
    for (const auto& [field, value] : entry.values) {
        Difference difference{kind, field, entry.words, {}, {}, std::nullopt};
        (kind == Difference::Kind::New ? difference.after : difference.before) = value;
        add(differences, std::move(difference));
    }
}

void compare(const NamedValues::Entry& before, const NamedValues::Entry& after,
             std::vector<Difference>& differences) {
    const auto kind = Difference::Kind::Changed;
    for (const auto& [field, value] : before.values) {
        const FieldValue* now = after.find(field->name);
        if (now == nullptr || now->text() != value.text()) {
            add(differences, {kind, field, before.words, value,
                              now != nullptr ? *now : FieldValue(), std::nullopt});
        }
    }
    for (const auto& [field, value] : after.values) {
        if (before.find(field->name) == nullptr) {
            add(differences, {kind, field, after.words, {}, value, std::nullopt});
        }
    }
}

std::vector<Difference> differencesByName(const NamedValues& before, const NamedValues& after) {
    std::vector<Difference> differences;
    for (const NamedValues::Entry& entry : before.entries()) {
        if (const NamedValues::Entry* now = after.sameAs(entry)) {
            compare(entry, *now, differences);
        } else {
            addAll(entry, Difference::Kind::Gone, differences);
        }
    }
    for (const NamedValues::Entry& entry : after.entries()) {
        if (before.sameAs(entry) == nullptr) {
            addAll(entry, Difference::Kind::New, differences);
        }
    }
    return differences;
}

} // namespace

std::vector<Difference> differencesBetween(const CurrentValues& before,
                                           const CurrentValues& after) {
    return &before.entries() == &after.entries()
               ? differencesOf(changesBetween(before, after), before)
               : differencesByName(NamedValues(before), NamedValues(after));
}

} // namespace pallax
