#include "fleet/ServerRecordings.h"

#include "fleet/IntervalRows.h"
#include "fleet/StoreAddress.h"
#include "store/FileRecordings.h"
#include "text/Format.h"

#include <algorithm>
#include <cstddef>
#include <tuple>
#include <utility>

namespace pallax {

namespace {

using Row = std::vector<QueryValue>;

/// Of an interval, as values() selects them.
enum Column : std::size_t {
    kField,
    kEntry,
    kSince,
    kHeld,
    kPacket,
    kNumber,
    kDecimals,
    kSuffix,
    kText,
    kRaw,
    kColumns
};

/// `first` is the beginning of the value's recording.
StoredValue valueOf(const Row& row, std::int64_t first) {
    StoredValue value;
    if (std::string entry = textIn(row[kEntry]); !entry.empty()) {
        value.entry = std::move(entry);
    }
    value.start = integerIn(row[kSince]) - first;
    value.end = value.start + integerIn(row[kHeld]);
    value.packet = static_cast<std::uint64_t>(integerIn(row[kPacket]));
    if (const auto* real = std::get_if<double>(&row[kNumber])) {
        value.number = *real;
    }
    const auto decimals = integerIn(row[kDecimals]);
    value.text =
        decimals < 0 || !value.number
            ? textIn(row[kText])
            : decimalText(*value.number, static_cast<std::size_t>(decimals)) + textIn(row[kSuffix]);
    if (const auto* raw = std::get_if<std::int64_t>(&row[kRaw])) {
        value.raw = *raw;
    }
    return value;
}

std::string listed(const std::vector<std::string>& names) {
    std::string text;
    for (const std::string& name : names) {
        text.append(text.empty() ? "" : ", ").append(clickHouseText(name));
    }
    return text;
}

} // namespace

std::vector<std::string> ServerRecordings::devices() {
    std::vector<std::string> devices;
    for (const Row& row :
         _store.server().rows("SELECT DISTINCT device FROM recordings ORDER BY device", 1)) {
        devices.push_back(textIn(row.front()));
    }
    return devices;
}

std::vector<LoadedRecording> ServerRecordings::ofDevice(const std::string& device) {
    return _store.ofDevice(device);
}

std::string ServerRecordings::fromRowsOf(const LoadedRecording& recording,
                                         const std::string& name) const {
    return formatText(
        "FROM %@ WHERE device = %@ AND load = %@",
        {_store.table(name), clickHouseText(recording.device), std::to_string(recording.id)});
}

void ServerRecordings::values(const LoadedRecording& recording,
                              const std::vector<std::string>& fields, const TakeValue& take) {
    if (fields.empty()) {
        return;
    }
    const std::string query = formatText(
        "SELECT field, entry, (toInt64(day) * 1440 + minute) * 60000 + toInt64(second) * 1000 + ms "
        "AS since, toInt64(hold_minutes) * 60000 + toInt64(hold_seconds) * 1000 + hold_ms AS held, "
        "toInt64(packet_high) * 65536 + toInt64(packet_middle) * 256 + packet_low AS packet, "
        "if(known = 1, steps * step + rest, NULL) AS number, decimals, suffix, text, raw %@ "
        "AND field IN (%@) ORDER BY packet, since",
        {fromRowsOf(recording, "intervals"), listed(fields)});
    _store.server().eachRow(query, kColumns, [&](const Row& row) {
        const auto field = std::find(fields.begin(), fields.end(), textIn(row[kField]));
        if (field != fields.end()) {
            take(static_cast<std::size_t>(field - fields.begin()), valueOf(row, recording.first));
        }
    });
}

std::vector<Event> ServerRecordings::events(const LoadedRecording& recording) {
    std::vector<Event> events;
    for (const Row& row : _store.server().rows(
             formatText("SELECT time, packet, kind, words %@", {fromRowsOf(recording, "events")}),
             4)) {
        if (auto event =
                storedEvent(integerIn(row[0]), integerIn(row[1]), textIn(row[2]), textIn(row[3]))) {
            events.push_back(*std::move(event));
        }
    }
    std::sort(events.begin(), events.end(), [](const Event& one, const Event& other) {
        return std::tie(one.packet, one.time, one.kind, one.words) <
               std::tie(other.packet, other.time, other.kind, other.words);
    });
    return events;
}

std::unique_ptr<StoredRecordings> openRecordings(const std::string& store) {
    if (isStoreAddress(store)) {
        return std::make_unique<ServerRecordings>(parseStoreAddress(store));
    }
    return std::make_unique<FileRecordings>(store);
}

} // namespace pallax
