#include "store/FileStore.h"

#include "fields/Measures.h"
#include "query/CellFinder.h"
#include "query/TimelineTables.h"
#include "store/IntervalBatch.h"
#include "store/IntervalTable.h"
#include "store/RecordingMeasurements.h"
#include "store/RecordingRows.h"

namespace pallax {

namespace {

std::string joined(const std::vector<std::string>& names) {
    std::string text;
    for (const std::string& name : names) {
        text.append(text.empty() ? "" : " ").append(name);
    }
    return text;
}

} // namespace

std::optional<LoadedRecording> FileStore::withDigest(const std::string& digest) {
    Statement find = _connection->prepare(selectRecordings("digest = ?").c_str());
    return find.bind(1, digest).step() ? std::optional(recordingOf(find)) : std::nullopt;
}

std::vector<LoadedRecording> FileStore::beginningAt(const std::string& technology,
                                                    std::int64_t first) {
    Statement find = _connection->prepare(selectRecordings("first = ? AND technology = ?").c_str());
    find.bind(1, first).bind(2, technology);
    std::vector<LoadedRecording> recordings;
    while (find.step()) {
        recordings.push_back(recordingOf(find));
    }
    return recordings;
}

void FileStore::begin() {
    _transaction.emplace(*_connection);
    _names.emplace(*_connection);
}

void FileStore::add(const LoadedRecording& recording) {
    Statement add = _connection->prepare(
        "INSERT INTO recordings (device, name, digest, beginnings, technology, decoder, every, "
        "identities, packets, first, last, trouble) VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?) "
        "RETURNING id");
    int parameter = 1;
    for (const std::string* text :
         {&recording.device, &recording.name, &recording.digest, &recording.beginnings,
          &recording.technology, &recording.decoder, &recording.every, &recording.identities}) {
        add.bind(parameter++, *text);
    }
    for (const std::int64_t number : {recording.packets, recording.first, recording.last}) {
        add.bind(parameter++, number);
    }
    add.bind(parameter, recording.trouble).step();
    _recording = add.integer(0);
    add.run();
}

void FileStore::write(IntervalBatch& intervals) {
    writeIntervals(intervals, *_connection, _recording, *_names);
}

void FileStore::addEvents(const std::vector<Event>& events) {
    Statement add = _connection->prepare("INSERT INTO events VALUES (?, ?, ?, ?, ?, ?)");
    for (const Event& event : events) {
        add.bind(1, _recording).bind(2, microseconds(event.time));
        add.bind(3, static_cast<std::int64_t>(event.packet)).bind(4, wordOf(event.kind));
        add.bind(5, event.words).bind(6, joined(event.fields)).run();
    }
}

void FileStore::addFound(const RecordingMeasurements& measurements) {
    Statement add =
        _connection->prepare("INSERT INTO cells VALUES (?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?, ?)");
    for (const FoundCell& cell : measurements.cells()) {
        const auto level = [&](auto value) {
            return cell.hasLevel ? std::optional(value) : std::nullopt;
        };
        int column = 0;
        add.bind(++column, _recording);
        add.bind(++column, wordOf(cell.role));
        add.bind(++column, nameOf(cell.system));
        add.bind(++column, cell.identity);
        bindAny(add, ++column, cell.code);
        bindAny(add, ++column, cell.channel);
        add.bind(++column, microseconds(cell.first));
        add.bind(++column, microseconds(cell.last));
        add.bind(++column, static_cast<std::int64_t>(cell.packet));
        add.bind(++column, static_cast<std::int64_t>(cell.readings));
        add.bind(++column, level(infoOf(cellTermsOf(cell.system).level).name));
        add.bind(++column, level(cell.best));
        add.bind(++column, level(cell.latest));
        add.run();
    }
    for (FieldIndex field = 0; field < measurements.fields().size(); ++field) {
        (void)_names->field(measurements.fields()[field]);
    }
}

/// Sums up the intervals of levels.
void FileStore::addTotals() {
    Statement add = _connection->prepare(
        "INSERT INTO totals (field, site, recording, number, hold, first) "
        "SELECT f.id, coalesce(s.site, 0), ?1, CASE typeof(i.number) WHEN 'integer' THEN "
        "i.number * s.step ELSE i.number END AS held, sum(i.hold), min(i.time) "
        "FROM fields f CROSS JOIN series s ON s.field = f.id AND s.recording = ?1 "
        "CROSS JOIN intervals i ON i.id BETWEEN s.first_row AND s.last_row "
        "WHERE f.name = ?2 AND i.number IS NOT NULL AND i.hold > 0 GROUP BY f.id, 2, held");
    for (const MeasuredField& field : measuredFields()) {
        add.bind(1, _recording).bind(2, field.name).run();
    }
}

void FileStore::remove(const LoadedRecording& recording) {
    constexpr const char* kIntervals =
        "DELETE FROM intervals WHERE id BETWEEN (SELECT min(first_row) FROM series WHERE recording "
        "= ?1) AND (SELECT max(last_row) FROM series WHERE recording = ?1)";
    constexpr const char* kTotals = "DELETE FROM totals WHERE recording = ?1 AND (field, site) IN "
                                    "(SELECT field, coalesce(site, 0) FROM series WHERE recording "
                                    "= ?1)";
    for (const char* sql :
         {kIntervals, kTotals, "DELETE FROM series WHERE recording = ?1",
          "DELETE FROM events WHERE recording = ?1", "DELETE FROM cells WHERE recording = ?1",
          "DELETE FROM recordings WHERE id = ?1"}) {
        _connection->prepare(sql).bind(1, static_cast<std::int64_t>(recording.id)).run();
    }
}

void FileStore::finish(const std::optional<std::string>& trouble) {
    if (trouble) {
        _connection->prepare("UPDATE recordings SET trouble = ? WHERE id = ?")
            .bind(1, *trouble)
            .bind(2, _recording)
            .run();
    }
    addTotals();
    _transaction->commit();
    abandon();
}

void FileStore::abandon() {
    _names.reset();
    _transaction.reset();
}

} // namespace pallax
