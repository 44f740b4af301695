#include "fleet/ServerStore.h"

#include "fleet/IntervalRows.h"
#include "fleet/StoreSetup.h"
#include "host/Sha256.h"
#include "query/CellFinder.h"
#include "query/TimelineTables.h"
#include "store/IntervalBatch.h"
#include "text/Format.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <map>
#include <random>
#include <set>
#include <thread>
#include <tuple>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kLoadColumns =
    "load, gone, device, name, digest, beginnings, technology, decoder, every, identities, "
    "packets, first, last, trouble";
constexpr std::size_t kLoadColumnCount = 14;
/// Rows are sent in pieces of about this size.
constexpr std::size_t kPiece = std::size_t{1} << 20U;

/// A row of kLoadColumns.
LoadedRecording recordingOf(const std::vector<QueryValue>& row) {
    LoadedRecording recording;
    auto cell = row.begin();
    recording.id = static_cast<std::uint64_t>(integerIn(*cell));
    std::advance(cell, 2); // gone
    for (std::string* text :
         {&recording.device, &recording.name, &recording.digest, &recording.beginnings,
          &recording.technology, &recording.decoder, &recording.every, &recording.identities}) {
        *text = textIn(*cell++);
    }
    for (std::int64_t* number : {&recording.packets, &recording.first, &recording.last}) {
        *number = integerIn(*cell++);
    }
    if (const std::string trouble = textIn(*cell); !trouble.empty()) {
        recording.trouble = trouble;
    }
    return recording;
}

void appendLoad(RowBinary& rows, const LoadedRecording& recording, std::uint64_t load,
                bool isGone) {
    rows.add(load).add(std::uint8_t{isGone});
    for (const std::string* text :
         {&recording.device, &recording.name, &recording.digest, &recording.beginnings,
          &recording.technology, &recording.decoder, &recording.every, &recording.identities}) {
        rows.add(*text);
    }
    rows.add(recording.packets).add(recording.first).add(recording.last);
    rows.add(recording.trouble.value_or(""));
}

/// Numbers of loads grow with the time, and those of two programs differ.
std::uint64_t numberOfLoad() {
    constexpr unsigned kRandomBits = 20;
    const auto now = std::chrono::floor<std::chrono::milliseconds>(
        std::chrono::system_clock::now().time_since_epoch());
    std::random_device random;
    return (static_cast<std::uint64_t>(now.count()) << kRandomBits) |
           (random() & ((1U << kRandomBits) - 1));
}

/// A part of a cell's identity.
std::optional<std::string> anyOf(const FieldValue& value) {
    if (!std::isnan(value.number)) {
        return std::to_string(static_cast<std::int64_t>(value.number));
    }
    return value.isEmpty() ? std::nullopt : std::optional(value.text());
}

std::string joined(const std::vector<std::string>& names) {
    std::string text;
    for (const std::string& name : names) {
        text.append(text.empty() ? "" : " ").append(name);
    }
    return text;
}

} // namespace

ServerStore::ServerStore(const StoreAddress& address, Patience patience)
    : _patience(patience), _server(address, patience) {
    const auto rows = _server.rows("SELECT version, cluster, copies FROM store", 3);
    const std::int64_t version = rows.size() == 1 ? integerIn(rows.front()[0]) : 0;
    if (version > kServerStoreVersion) {
        throw StoreFailure(formatText("%@ is a store of a later version of Pallax: its tables have "
                                      "version %lld, and this program knows version %u.",
                                      {address.text(), version, kServerStoreVersion}));
    }
    if (version != kServerStoreVersion) {
        throw StoreFailure(formatText("%@ has other tables than a store.", {address.text()}));
    }
    _isSharded = !textIn(rows.front()[1]).empty();
    _copies = integerIn(rows.front()[2]);
}

std::string ServerStore::table(const std::string& name) const {
    return _isSharded ? name : name + "_local";
}

std::string ServerStore::currentLoads() const {
    return formatText("load IN (SELECT load FROM %@.current_local)", {_server.address().database});
}

std::vector<LoadedRecording> ServerStore::loads(const std::string& condition,
                                                const std::string& by) {
    std::vector<LoadedRecording> recordings;
    for (const auto& row :
         _server.rows(formatText("SELECT %@ FROM %@ WHERE %@ ORDER BY digest, load DESC LIMIT 1 BY "
                                 "%@",
                                 {kLoadColumns, table("loads"), condition, by}),
                      kLoadColumnCount)) {
        if (integerIn(row[1]) == 0) {
            recordings.push_back(recordingOf(row));
        }
    }
    return recordings;
}

std::vector<LoadedRecording> ServerStore::ofDevice(const std::string& device) {
    std::vector<LoadedRecording> recordings = loads("device = " + clickHouseText(device), "digest");
    std::sort(recordings.begin(), recordings.end(), [](const auto& one, const auto& other) {
        return std::tie(one.first, one.name) < std::tie(other.first, other.name);
    });
    return recordings;
}

std::optional<LoadedRecording> ServerStore::withDigest(const std::string& digest) {
    const auto found = loads("digest = " + clickHouseText(digest), "digest");
    return found.empty() ? std::nullopt : std::optional(found.front());
}

std::vector<LoadedRecording> ServerStore::beginningAt(const std::string& technology,
                                                      std::int64_t first) {
    return loads(
        formatText("technology = %@ AND first = %lld", {clickHouseText(technology), first}),
        "digest");
}

void ServerStore::begin() {
    abandon();
}

void ServerStore::abandon() {
    _replaced.clear();
    _fields.clear();
    _rows = 0;
}

void ServerStore::remove(const LoadedRecording& recording) {
    _replaced.push_back(recording);
}

void ServerStore::add(const LoadedRecording& recording) {
    _recording = recording;
    _recording.id = numberOfLoad();
    for (const LoadedRecording& before : _replaced) {
        // Even if the clock of the machine that loaded it is ahead.
        _recording.id = std::max(_recording.id, before.id + 1);
    }
}

void ServerStore::insert(const std::string& name, std::string_view columns, const RowBinary& rows) {
    if (!rows.bytes().empty()) {
        _server.insert(formatText("%@ (%@)", {table(name), columns}),
                       [piece = std::string_view(rows.bytes())]() mutable {
                           return std::exchange(piece, {});
                       });
    }
}

void ServerStore::write(IntervalBatch& intervals) {
    const auto sorted = intervals.sorted();
    std::set<std::string> fields(_fields.begin(), _fields.end());
    auto next = sorted.begin();
    RowBinary rows;
    if (!sorted.empty()) {
        _server.insert(formatText("%@ (%@)", {table("intervals"), kIntervalColumns}), [&] {
            rows.clear();
            for (; next != sorted.end() && rows.bytes().size() < kPiece; ++next) {
                appendInterval(rows, *next, intervals, _recording);
                fields.insert(
                    intervals.measurements().fields()[intervals.series(*next).field].name);
            }
            return std::string_view(rows.bytes());
        });
    }
    _fields.assign(fields.begin(), fields.end());
    _rows += static_cast<std::int64_t>(sorted.size());
    intervals.clear();
}

void ServerStore::addEvents(const std::vector<Event>& events) {
    RowBinary rows;
    for (const Event& event : events) {
        rows.add(_recording.device).add(_recording.id).add(monthOf(_recording.first));
        rows.add(_recording.name).add(microseconds(event.time));
        rows.add(static_cast<std::int64_t>(event.packet)).add(wordOf(event.kind));
        rows.add(event.words).add(joined(event.fields));
    }
    insert("events", "device, load, month, recording, time, packet, kind, words, fields", rows);
    _rows += static_cast<std::int64_t>(events.size());
}

void ServerStore::addFound(const RecordingMeasurements& measurements) {
    addCells(measurements);
    addFields(measurements);
}

void ServerStore::addCells(const RecordingMeasurements& measurements) {
    RowBinary rows;
    for (const FoundCell& cell : measurements.cells()) {
        const auto level = [&](auto value) {
            return cell.hasLevel ? std::optional(value) : std::nullopt;
        };
        rows.add(_recording.device).add(_recording.id).add(monthOf(_recording.first));
        rows.add(_recording.name).add(wordOf(cell.role)).add(nameOf(cell.system));
        rows.add(cell.identity).add(anyOf(cell.code)).add(anyOf(cell.channel));
        rows.add(microseconds(cell.first)).add(microseconds(cell.last));
        rows.add(static_cast<std::int64_t>(cell.packet));
        rows.add(static_cast<std::int64_t>(cell.readings));
        rows.add(level(infoOf(cellTermsOf(cell.system).level).name));
        rows.add(level(cell.best)).add(level(cell.latest));
    }
    insert("cells",
           "device, load, month, recording, role, system, identity, code, channel, first_time, "
           "last_time, packet, readings, measure, best_level, last_level",
           rows);
    _rows += static_cast<std::int64_t>(measurements.cells().size());
}

void ServerStore::addFields(const RecordingMeasurements& measurements) {
    std::map<std::string, std::string> known; // the digest that the store has for each name
    for (const auto& row : _server.rows(
             "SELECT name, argMax(content, load) FROM " + table("fields") + " GROUP BY name", 2)) {
        known.emplace(textIn(row[0]), textIn(row[1]));
    }
    RowBinary rows;
    for (FieldIndex index = 0; index < measurements.fields().size(); ++index) {
        const FieldInfo& field = measurements.fields()[index];
        RowBinary row;
        row.add(field.name).add(field.path).add(kindName(field.kind)).add(field.unit);
        row.add(field.least).add(field.most);
        for (const bool flag : {field.isInList, field.identifies, field.isPersonal}) {
            row.add(std::uint8_t{flag});
        }
        row.add(field.meaning).add(std::uint8_t{field.isShown});
        const std::string content = Sha256().add(std::string_view(row.bytes())).finish();
        const auto there = known.find(field.name);
        if (there == known.end() || there->second != content) {
            rows.append(row).add(_recording.id).add(content);
        }
    }
    insert("fields",
           "name, path, kind, unit, least, most, in_list, identifies, personal, meaning, shown, "
           "load, content",
           rows);
}

/// The rows of this load that copies have. Servers of other shards may be missing: without them
/// nothing of it is missed, and without one of its own shard the sum is short.
std::int64_t ServerStore::rowsOfCopies() {
    const std::string own =
        formatText("month = %u AND device = %@ AND load = %@ SETTINGS skip_unavailable_shards = 1",
                   {monthOf(_recording.first), clickHouseText(_recording.device),
                    std::to_string(_recording.id)});
    std::string fields = "''";
    for (const std::string& field : _fields) {
        fields += ", " + clickHouseText(field);
    }
    std::int64_t rows = 0;
    for (const std::string& of :
         {formatText("intervals_everywhere WHERE field IN (%@)", {fields}),
          std::string("events_everywhere WHERE 1"), std::string("cells_everywhere WHERE 1")}) {
        rows += integerIn(
            _server.rows(formatText("SELECT count() FROM %@ AND %@", {of, own}), 1).at(0)[0]);
    }
    return rows;
}

/// Copies get the rows of a table in any order, and those of two tables independently. So all must
/// have all rows before the load's own row is written.
void ServerStore::waitForCopies() {
    constexpr std::chrono::milliseconds kPause{50};
    auto latest = std::chrono::steady_clock::now();
    std::int64_t most = 0;
    while (_copies > 1) {
        const std::int64_t there = rowsOfCopies();
        if (there == _rows * _copies) {
            return;
        }
        const auto now = std::chrono::steady_clock::now();
        if (there > most) {
            most = there;
            latest = now;
        }
        if (now - latest >= _patience.copies) {
            throw StoreFailure(formatText("%@: not all copies of a shard have what was sent; "
                                          "nothing was loaded.",
                                          {_server.address().text()}));
        }
        std::this_thread::sleep_for(kPause);
    }
}

/// In one block, so that all of these are seen at once.
void ServerStore::writeLoads(const std::vector<LoadedRecording>& gone, bool withThis) {
    RowBinary rows;
    for (const LoadedRecording& recording : gone) {
        appendLoad(rows, recording, recording.id + 1, true);
    }
    if (withThis) {
        appendLoad(rows, _recording, _recording.id, false);
    }
    insert("loads", kLoadColumns, rows);
}

void ServerStore::finish(const std::optional<std::string>& trouble) {
    _recording.trouble = trouble;
    waitForCopies();
    std::erase_if(_replaced, [&](const LoadedRecording& before) {
        return before.digest == _recording.digest && before.device == _recording.device;
    });
    writeLoads(_replaced, true);
    settle();
    abandon();
}

/// Another program may have loaded the same recording meanwhile, for another device or up to
/// another packet. Each looks after its own row is there, and both choose the same one.
void ServerStore::settle() {
    const auto there = loads(formatText("technology = %@ AND first = %lld",
                                        {clickHouseText(_recording.technology), _recording.first}),
                             "digest, device");
    std::vector<LoadedRecording> gone;
    for (const LoadedRecording& other : there) {
        const bool isThis = other.digest == _recording.digest && other.device == _recording.device;
        if (isThis || !haveSameBeginning(_recording, other)) {
            continue;
        }
        const bool isLess =
            std::pair(other.packets, other.id) < std::pair(_recording.packets, _recording.id);
        gone.push_back(isLess ? other : _recording);
    }
    writeLoads(gone, false);
}

} // namespace pallax
