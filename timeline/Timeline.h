#pragma once

#include "packets/PacketJournal.h"
#include "timeline/CurrentValues.h"
#include "timeline/Event.h"
#include "timeline/EventFinder.h"
#include "timeline/KeyFrames.h"
#include "timeline/Replay.h"
#include "timeline/SeriesStore.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace pallax {

/// Asked from time to time during long work; false stops it.
using MayContinue = std::function<bool()>;

/// The packets with stamps that do not step back.
struct Stretch {
    std::uint64_t firstPacket = 0;
    Time first;
    Time latest;
};

/// An index of a recording or live session: what happened when, and how to get at any instant
/// again. An instant is the number of a packet and means the state after it; 0 is the state before
/// the first. The packets themselves stay in the journal and are decoded again from a key frame.
///
/// Nothing here writes a log line, prints a notice or ends the program. A record that throws ends
/// the timeline before its packet, with an event. Not for several threads.
class Timeline {
public:
    struct Limits {
        KeyFrames::Limits keyFrames = {};
        SeriesStore::Limits series = {};
        std::size_t events = 65536;
        std::chrono::nanoseconds pingPong = EventFinder::kPingPong;
    };

    /// The journal and what `source` names must outlive the timeline.
    Timeline(PacketJournal& journal, const DecodingSource& source)
        : Timeline(journal, source, Limits{}) {}
    Timeline(PacketJournal& journal, const DecodingSource& source, const Limits& limits);
    ~Timeline();
    Timeline(const Timeline&) = delete;
    Timeline& operator=(const Timeline&) = delete;

    /// Reads on from where the last call stopped. True at the end of the journal, where it can be
    /// called again when packets have come; false if `mayContinue` stopped it.
    bool index(const MayContinue& mayContinue = {});
    /// Whether a record has thrown: later packets are not read.
    bool hasEnded() const { return _hasEnded; }

    /// The latest instant.
    std::uint64_t packets() const { return _packets; }
    /// The earliest instant: 0, unless the journal has dropped packets.
    std::uint64_t firstInstant() const;
    const std::vector<Stretch>& stretches() const { return _stretches; }
    /// The latest packets of the first stretch that has this time: all until the first one that is
    /// later. Nothing before the first packet.
    std::optional<std::uint64_t> instantAt(Time time) const;
    /// The same in one of the stretches, which has begun by then.
    std::uint64_t instantIn(const Stretch& stretch, Time time) const;
    /// The stretch in which a time is looked for: the first that has it, or else the one that ends
    /// latest before it; null before the first packet.
    const Stretch* stretchOf(Time time) const;
    /// The stretch of an instant: that of its packet, or the first one; null before any packet.
    const Stretch* stretchOfInstant(std::uint64_t instant) const;

    const FieldTable& fields() const { return _fields; }
    const EntryTable& entries() const { return _entries; }
    const SeriesStore& series() const { return _series; }
    const KeyFrames& keyFrames() const { return _keyFrames; }
    /// Adds an event that its packets do not tell, such as an alarm, after those of its packet.
    /// Nothing happens if it is there already, or too early.
    void add(Event event);
    /// The latest events, in the order of their packets.
    const std::vector<Event>& events() const { return _events; }
    /// How many earlier ones there were no room for.
    std::uint64_t eventsDropped() const { return _eventsDropped; }
    /// Sentences about what was left out or went wrong; empty if all is well.
    std::vector<std::string> notes() const;

    /// The current values at the latest instant.
    const CurrentValues& latestValues() const;
    /// The current values at an instant. The instant must lie between the earliest and the latest.
    CurrentValues valuesAt(std::uint64_t instant);
    /// The display at an instant as `decode` shows it; null before the first packet. Nothing else
    /// shares it.
    PropertyList displayAt(std::uint64_t instant);
    /// A decoder that has read the packets up to an instant.
    std::unique_ptr<Replay> replayAt(std::uint64_t instant);
    /// One that goes on after a key frame.
    std::unique_ptr<Replay> replayFrom(const KeyFrame& from, std::uint64_t packet) const;
    /// Reads on to a later instant.
    void advance(Replay& replay, std::uint64_t instant, SampleSink* sink = nullptr);

    /// Gives the samples of the packets from `from` up to and including `to` to a sink; packets
    /// that are not there are left out. False if `mayContinue`, asked before each packet, stopped
    /// it.
    bool read(std::uint64_t from, std::uint64_t to, SampleSink& sink,
              const MayContinue& mayContinue = {});

    // For what is built on a timeline.
    PacketJournal& journal() const { return _journal; }
    SeriesValue seriesValueOf(const FieldValue& value) { return _series.valueOf(value); }
    FieldTable& fieldTable() { return _fields; }
    EntryTable& entryTable() { return _entries; }

private:
    class Indexer;

    PacketJournal& _journal;
    KeptResources _resources;
    DecodingSource _source;
    FieldTable _fields;
    EntryTable _entries;
    KeyFrames _keyFrames;
    SeriesStore _series;
    std::size_t _mostEvents;
    std::vector<Event> _events;
    std::uint64_t _eventsDropped = 0;
    std::vector<Stretch> _stretches;
    std::uint64_t _packets = 0;
    bool _hasEnded = false;
    std::unique_ptr<Indexer> _indexer;
};

} // namespace pallax
