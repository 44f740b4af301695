#pragma once

#include "packets/StampSequence.h"
#include "timeline/CurrentValues.h"
#include "timeline/Event.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The access point of a packet data context, if the object has one.
std::string contextName(const PropertyList& context);

/// Finds the events of a recording in its values, packet by packet.
class EventFinder {
public:
    /// A cell change back to the cell before counts as ping-pong within this time.
    static constexpr std::chrono::seconds kPingPong{10};

    EventFinder(std::string_view technology, const FieldTable& fields, EntryTable& entries,
                std::chrono::nanoseconds pingPong = kPingPong);

    // Called for each value of a packet.
    void valueRead(FieldIndex field, const FieldValue& value) {
        if (field < _watched.size() && _watched[field].isWatched) {
            noteValue(_watched[field], value);
        }
    }
    void valueRemoved(FieldIndex field) { valueRead(field, {}); }
    void listReplaced(ListId list) { _hasChanged = _hasChanged || list == _contexts; }

    /// Appends the events of a packet to `events`. `values` are those after it.
    void endPacket(std::uint64_t packet, Time time, const CurrentValues& values,
                   std::vector<Event>& events);
    /// The next packet's stamp steps: how long the current values have held is unknown.
    void noteStep();
    /// The packet's stamp steps.
    static Event eventOf(const StampRemark& step, std::uint64_t packet, Time time);

private:
    /// What is known of one row.
    struct Row {
        const EventFields* rule;
        std::vector<FieldIndex> fields;
        bool isKnown = false;
        std::vector<std::string> value; ///< of each field; of contexts, their names
        std::vector<std::string> before;
        Time since;
        bool isInterrupted = false; ///< by a gap or a step of the clock since then
        std::optional<bool> isGood;
    };
    struct Moment {
        std::uint64_t packet;
        Time time;
        const CurrentValues& values;
        std::vector<Event>& events;
    };

    struct Watched {
        bool isWatched = false;
        PropertyList latest;
    };

    void noteValue(Watched& watched, const FieldValue& value);
    void look(Row& row, const Moment& moment);
    void lookAtCell(Row& row, const Moment& moment);
    void lookAtState(Row& row, const Moment& moment);
    void lookAtService(Row& row, const Moment& moment);
    /// The greatest time there is if it is unknown.
    static std::chrono::nanoseconds timeSince(const Row& row, const Moment& moment);
    /// " after 31 s"; empty if it is unknown.
    static std::string dwell(const Row& row, const Moment& moment);
    void lookAtContexts(Row& row, const Moment& moment);
    bool isOvershadowed(const Row& row, const Moment& moment) const;
    static void add(const Row& row, EventKind kind, std::string words, const Moment& moment);

    std::chrono::nanoseconds _pingPong;
    std::vector<Row> _rows;
    std::vector<Watched> _watched; ///< by field
    ListId _contexts = 0;
    bool _hasChanged = false;
};

} // namespace pallax
