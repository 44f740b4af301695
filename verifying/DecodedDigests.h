#pragma once

#include "LogGenerator/Records/Sample.h"
#include "host/Sha256.h"
#include "timeline/FieldTable.h"
#include "verifying/RecordingDigest.h"

#include <cstdint>
#include <map>
#include <string>
#include <string_view>

namespace pallax {

/// Computes the digests of the values that a recording gives, field by field and minute by minute.
/// Its memory grows by a digest for each of them.
class DecodedDigests final : public SampleSink {
public:
    explicit DecodedDigests(FieldTable fields) : _fields(std::move(fields)) {}

    /// The packet that follows: its minute and its number.
    void begin(std::int64_t minute, std::uint64_t packet);
    void unreadable(std::string_view reason);
    std::map<RecordingDigest::Decoded, std::string> finish();

    void sample(const Sample& sample) override;
    void keyRemoved(std::string_view key) override { add("removed", key); }
    void beginList(const SampleList& list) override;
    void endList() override { _entry.clear(); }
    void beginEntry(std::size_t index, std::int64_t name) override;
    void endEntry() override { _entry.clear(); }

private:
    void add(const std::string& field, std::string_view value);
    void finishMinute();

    FieldTable _fields;
    std::int64_t _minute = 0;
    std::uint64_t _packet = 0;
    std::string _entry;                  ///< in which the samples are, if in one
    std::map<std::string, Sha256> _open; ///< of the minute, by field
    std::map<RecordingDigest::Decoded, std::string> _finished;
};

} // namespace pallax
