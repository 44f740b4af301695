#include "timeline/Changes.h"

#include <algorithm>
#include <unordered_map>

namespace pallax {

namespace {

using Entries = std::unordered_map<EntryId, const EntryValues*>;

Entries entriesIn(const CurrentValues& values) {
    Entries entries;
    values.forEachEntry([&](const EntryValues& entry) { entries.emplace(entry.entry, &entry); });
    return entries;
}

void addAll(const EntryValues& entry, Change::Kind kind, std::vector<Change>& changes) {
    for (const auto& [field, value] : entry.values) {
        Change change{kind, field, entry.entry, {}, {}};
        (kind == Change::Kind::Added ? change.after : change.before) = value;
        changes.push_back(std::move(change));
    }
}

void compare(const EntryValues& before, const EntryValues& after, std::vector<Change>& changes) {
    for (const auto& [field, value] : before.values) {
        const FieldValue* now = after.value(field);
        if (now == nullptr || !(*now == value)) {
            changes.push_back({Change::Kind::Value, field, before.entry, value,
                               now != nullptr ? *now : FieldValue()});
        }
    }
    for (const auto& [field, value] : after.values) {
        if (before.value(field) == nullptr) {
            changes.push_back({Change::Kind::Value, field, after.entry, {}, value});
        }
    }
}

} // namespace

std::vector<Change> changesBetween(const CurrentValues& before, const CurrentValues& after) {
    std::vector<Change> changes;
    const std::size_t fields = std::max(before.fieldCount(), after.fieldCount());
    for (FieldIndex field = 0; field < fields; ++field) {
        const FieldValue* then = before.value(field);
        const FieldValue* now = after.value(field);
        const FieldValue none;
        if (!((then != nullptr ? *then : none) == (now != nullptr ? *now : none))) {
            changes.push_back({Change::Kind::Value, field, kNoEntry, then != nullptr ? *then : none,
                               now != nullptr ? *now : none});
        }
    }
    const Entries former = entriesIn(before);
    const Entries current = entriesIn(after);
    before.forEachEntry([&](const EntryValues& entry) {
        const auto now = current.find(entry.entry);
        if (now == current.end()) {
            addAll(entry, Change::Kind::Removed, changes);
        } else if (former.at(entry.entry) == &entry) {
            compare(entry, *now->second, changes);
        }
    });
    after.forEachEntry([&](const EntryValues& entry) {
        if (!former.contains(entry.entry)) {
            addAll(entry, Change::Kind::Added, changes);
        }
    });
    return changes;
}

} // namespace pallax
