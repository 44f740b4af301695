#include "store/RecordingRows.h"

#include <cstdint>

namespace pallax {

std::string selectRecordings(const std::string& condition) {
    return "SELECT id, device, name, digest, beginnings, technology, decoder, every, identities, "
           "packets, "
           "first, last, trouble FROM recordings WHERE " +
           condition;
}

LoadedRecording recordingOf(const Statement& row) {
    LoadedRecording recording;
    int column = 0;
    recording.id = static_cast<std::uint64_t>(row.integer(column++));
    for (std::string* text :
         {&recording.device, &recording.name, &recording.digest, &recording.beginnings,
          &recording.technology, &recording.decoder, &recording.every, &recording.identities}) {
        *text = row.text(column++);
    }
    for (std::int64_t* number : {&recording.packets, &recording.first, &recording.last}) {
        *number = row.integer(column++);
    }
    if (!row.isNull(column)) {
        recording.trouble = row.text(column);
    }
    return recording;
}

} // namespace pallax
