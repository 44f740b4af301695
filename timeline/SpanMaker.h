#pragma once

#include "timeline/CurrentValues.h"

#include <cstdint>
#include <deque>
#include <unordered_map>
#include <vector>

namespace pallax {

/// A value of a field, and how long it held.
struct Span {
    FieldIndex field = 0;
    EntryId entry = kNoEntry;
    FieldValue value;
    std::uint64_t packet = 0; ///< in which it was read first
    std::uint32_t place = 0;  ///< of that reading in the packet, as the caller counts
    Time start;
    Time end; ///< not before `start`
};

/// Joins readings of the same value to spans. A span ends when another value is read, when the
/// field or the entry is gone, and where the caller says that what follows does not continue it.
class SpanMaker {
public:
    /// The readings that follow are those of this packet.
    void beginPacket(std::uint64_t packet, Time time);
    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value,
                   std::uint32_t place = 0);
    void valueRemoved(FieldIndex field);
    /// The entries of the list that the packet does not read end with it.
    void listReplaced(ListId list);

    /// Ends the spans whose values the current packet has not read.
    void endUnread();
    /// Ends all spans at the time of the current packet.
    void endAll();

    /// Those that have ended, in the order of their ends. The caller removes them.
    std::deque<Span>& ended() { return _ended; }

private:
    struct Open {
        Span span;
        std::uint64_t lastRead = 0; ///< the packet
        ListId list = 0;
    };
    using Key = std::uint64_t; ///< field and entry
    using Spans = std::unordered_map<Key, Open>;

    static Key keyOf(FieldIndex field, EntryId entry) {
        constexpr unsigned kHalf = 32;
        return std::uint64_t{field} << kHalf | entry;
    }

    void endReplaced();
    void end(Spans::iterator open);

    Spans _open;
    std::deque<Span> _ended;
    std::vector<ListId> _replaced; ///< by the current packet
    ListId _list = 0;
    std::uint64_t _packet = 0;
    Time _time;
};

} // namespace pallax
