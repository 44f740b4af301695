#pragma once

#include "monitor/DisplayDriver.h"
#include "monitor/PacketClock.h"
#include "packets/PacketJournal.h"
#include "platform/Resources.h"
#include "platform/StandardOutput.h"

#include <cstddef>
#include <map>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace pallax {

struct RecordedTechnology;

/// What decoding a recording needs. All must outlive its users.
struct DecodingSource {
    const RecordedTechnology& technology;
    const Resources& resources;
    const Bundle& bundle;
    std::span<const Technology> technologies;
};

/// Resources that are loaded once.
class KeptResources final : public Resources {
public:
    explicit KeptResources(const Resources& resources) : _resources(resources) {}

    std::optional<PropertyList> propertyList(std::string_view name) const override;
    std::vector<std::string> propertyListPaths() const override;

private:
    const Resources& _resources;
    mutable std::map<std::string, std::optional<PropertyList>, std::less<>> _loaded;
    mutable std::optional<std::vector<std::string>> _paths;
};

/// Decodes packets again, quietly: it writes no log line and no notice.
class Replay {
public:
    explicit Replay(const DecodingSource& source);
    ~Replay();
    Replay(const Replay&) = delete;
    Replay& operator=(const Replay&) = delete;

    /// Goes on after the packets of a key frame. Only before the first packet.
    void resume(const KeyFrame& from, std::uint64_t packet);
    /// Decodes the next packet and gives its samples to `sink`, if any. Exceptions of records pass
    /// through.
    void update(const JournalPacket& packet, SampleSink* sink);
    /// The number of the latest packet; 0 before the first.
    std::uint64_t packet() const { return _packet; }

    /// The display and its ages at a time after the latest packet.
    PropertyList displayAt(Time time);
    SectionAges ages();
    KeyFrame keyFrame();

private:
    class NoOutput final : public StandardOutput {
    public:
        void printLine(std::string_view /*line*/) override {}
    };

    PacketClock _clock;
    NoOutput _output;
    std::unique_ptr<DisplayDriver> _driver;
    SampleSink* _sink = nullptr;
    std::uint64_t _packet = 0;
    std::size_t _captured = 0; ///< bytes that the generator keeps for a history
};

} // namespace pallax
