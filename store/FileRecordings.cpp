#include "store/FileRecordings.h"

#include "store/RecordingRows.h"

#include <utility>

namespace pallax {

namespace {

StoredValue valueOf(const Statement& row) {
    enum IntervalColumn : int { kEntry, kStart, kEnd, kPacket, kNumber, kText, kRaw };
    StoredValue value;
    if (!row.isNull(kEntry)) {
        value.entry = row.text(kEntry);
    }
    value.start = row.integer(kStart);
    value.end = row.integer(kEnd);
    value.packet = static_cast<std::uint64_t>(row.integer(kPacket));
    if (!row.isNull(kNumber)) {
        value.number = row.real(kNumber);
    }
    value.text = row.text(kText);
    if (!row.isNull(kRaw)) {
        value.raw = row.integer(kRaw);
    }
    return value;
}

} // namespace

std::vector<std::string> FileRecordings::devices() {
    std::vector<std::string> devices;
    Statement find = _connection->prepare("SELECT DISTINCT device FROM recordings ORDER BY device");
    while (find.step()) {
        devices.push_back(find.text(0));
    }
    return devices;
}

std::vector<LoadedRecording> FileRecordings::ofDevice(const std::string& device) {
    std::vector<LoadedRecording> recordings;
    Statement find =
        _connection->prepare(selectRecordings("device = ? ORDER BY first, name").c_str());
    find.bind(1, device);
    while (find.step()) {
        recordings.push_back(recordingOf(find));
    }
    return recordings;
}

void FileRecordings::values(const LoadedRecording& recording,
                            const std::vector<std::string>& fields, const TakeValue& take) {
    Statement find = _connection->prepare(
        "SELECT s.entry, i.time, i.time + i.hold, i.packet, CASE typeof(i.number) WHEN 'integer' "
        "THEN i.number * s.step ELSE i.number END AS held, CASE WHEN i.text IS NULL THEN "
        "format(s.format, CASE typeof(i.number) WHEN 'integer' THEN i.number * s.step ELSE "
        "i.number END) ELSE t.text END, t.raw FROM fields f CROSS JOIN series s ON s.field = f.id "
        "AND s.recording = ?2 CROSS JOIN intervals i ON i.id BETWEEN s.first_row AND s.last_row "
        "LEFT JOIN texts t ON t.id = i.text WHERE f.name = ?1");
    for (std::size_t field = 0; field < fields.size(); ++field) {
        find.bind(1, fields[field]).bind(2, static_cast<std::int64_t>(recording.id));
        while (find.step()) {
            take(field, valueOf(find));
        }
    }
}

std::vector<Event> FileRecordings::events(const LoadedRecording& recording) {
    std::vector<Event> events;
    Statement find = _connection->prepare(
        "SELECT time, packet, kind, words FROM events WHERE recording = ? ORDER BY rowid");
    find.bind(1, static_cast<std::int64_t>(recording.id));
    while (find.step()) {
        if (auto event =
                storedEvent(find.integer(0), find.integer(1), find.text(2), find.text(3))) {
            events.push_back(*std::move(event));
        }
    }
    return events;
}

} // namespace pallax
