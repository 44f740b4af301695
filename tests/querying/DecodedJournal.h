#pragma once

#include "console/Output.h"
#include "decoding/DecodeCommand.h"
#include "decoding/DroppedNotices.h"
#include "tests/timeline/TimelineFixture.h"

#include <optional>
#include <string>
#include <utility>

namespace pallax {

/// A journal as a recording.
class JournalRecording final : public Recording {
public:
    JournalRecording(const MemoryJournal& journal, const RecordedTechnology& technology)
        : _journal(journal), _technology(technology) {}

    const std::string& name() const override { return _name; }
    int linkType() const override { return _technology.linkType; }
    const RecordedTechnology* technology() const override { return &_technology; }
    RecordingError foreignLinkType() const override { return {}; }
    std::optional<RecordedPacket> next() override {
        if (_next == _journal.size()) {
            return std::nullopt;
        }
        const JournalPacket packet = _journal.packet(++_next);
        return RecordedPacket{packet.time, packet.data, false};
    }
    const std::optional<RecordingError>& error() const override { return _error; }

private:
    const MemoryJournal& _journal;
    const RecordedTechnology& _technology;
    std::string _name = "drive";
    std::uint64_t _next = 0;
    std::optional<RecordingError> _error;
};

/// What `decode` writes of the packets of a fixture, which it must be able to read.
inline std::string decodedText(const TimelineFixture& fixture, DecodeOptions options) {
    options.recordings = {"drive"};
    DroppedNotices notices;
    std::string written;
    Output output([&written](std::string_view block) { written += block; });
    const auto open = [&fixture](const std::string& /*path*/) -> Recording::OpenResult {
        return std::unique_ptr<Recording>(
            std::make_unique<JournalRecording>(fixture.journal, fixture.technology));
    };
    // Gaps and steps of the clock are reported, and nothing else.
    DecodeCommand command(options, {fixture.resources, fixture.bundle, notices, technologies()},
                          open, [](std::string_view sentence) {
                              EXPECT_NE(sentence.find(" packet "), std::string::npos) << sentence;
                          });
    EXPECT_EQ(command.run(output), kExitSuccess);
    return written;
}

} // namespace pallax
