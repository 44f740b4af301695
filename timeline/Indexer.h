#pragma once

#include "timeline/Timeline.h"

namespace pallax {

/// The one pass over the packets that makes a timeline's index.
class Timeline::Indexer final : private CurrentValues::Listener {
public:
    explicit Indexer(Timeline& timeline, std::chrono::nanoseconds pingPong);

    bool run(const MayContinue& mayContinue);
    const CurrentValues& values() const { return _values; }

private:
    void take(const JournalPacket& packet);
    void noteStamp(const JournalPacket& packet);
    void addKeyFrame();
    void addEvent(Event event);
    void endAt(const JournalPacket& packet, std::string_view reason);

    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override {
        _timeline._series.add(field, entry, value);
        _finder.valueRead(field, value);
    }
    void entryRead(const EntryValues& entry) override {
        _timeline._series.add(entry);
        for (const auto& [field, value] : entry.values) {
            _finder.valueRead(field, value);
        }
    }
    void valueRemoved(FieldIndex field) override { _finder.valueRemoved(field); }
    void listReplaced(ListId list) override { _finder.listReplaced(list); }

    Timeline& _timeline;
    EventFinder _finder;
    CurrentValues _values;
    Replay _replay;
    TickGrid _grid;
    std::vector<ShownTick> _ticks; // the latest two
    std::unique_ptr<PacketReader> _reader;
    std::vector<Event> _found;
    std::uint64_t _packetsSince = 0; // the latest key frame
    std::uint64_t _bytesSince = 0;
};

} // namespace pallax
