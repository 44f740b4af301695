#include "verifying/DecodedDigests.h"

#include "decoding/DisplayOutput.h"

namespace pallax {

void DecodedDigests::begin(std::int64_t minute, std::uint64_t packet) {
    if (minute != _minute) {
        finishMinute();
    }
    _minute = minute;
    _packet = packet;
    _entry.clear();
}

void DecodedDigests::unreadable(std::string_view reason) {
    add(RecordingDigest::kUnreadable, reason);
}

void DecodedDigests::sample(const Sample& sample) {
    PropertyList value;
    sample.value.showIn(value);
    const std::string text = textOfValue(value);
    for (const FieldIndex field : _fields.of(sample)) {
        add(_fields[field].name, text);
    }
}

void DecodedDigests::beginList(const SampleList& list) {
    add("lists", list.key);
}

void DecodedDigests::beginEntry(std::size_t index, std::int64_t name) {
    _entry = std::to_string(index) + "/" + std::to_string(name);
}

/// Each part with its length, so that no two sequences are the same bytes.
void DecodedDigests::add(const std::string& field, std::string_view value) {
    Sha256& digest = _open[field];
    const std::string packet = std::to_string(_packet);
    for (const std::string_view part :
         {std::string_view(packet), std::string_view(_entry), value}) {
        digest.add(std::to_string(part.size()) + ":").add(part);
    }
}

/// A minute that comes again, after a clock was set back, goes on from its earlier digest.
void DecodedDigests::finishMinute() {
    for (auto& [field, digest] : _open) {
        std::string& finished = _finished[{_minute, field}];
        digest.add(finished);
        finished = digest.finish();
    }
    _open.clear();
}

std::map<RecordingDigest::Decoded, std::string> DecodedDigests::finish() {
    finishMinute();
    return std::move(_finished);
}

} // namespace pallax
