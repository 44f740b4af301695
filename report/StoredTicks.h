#pragma once

#include "store/StoredRecordings.h"
#include "timeline/CurrentValues.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// What a recording in a store shows at display ticks, as far as a report looks at it: cells with
/// their levels, neighbours, the network, states and contexts.
class StoredTicks {
public:
    /// All must outlive it. The fields are those of the recordings' technology.
    StoredTicks(StoredRecordings& store, FieldTable& fields, EntryTable& entries);

    struct Recording {
        LoadedRecording loaded;
        Time first;
        Time last; ///< nothing holds much longer
    };
    /// Calls `take` at each tick at which something is known, with the values that are known then
    /// and the first packet of the stretch of time.
    using Take = std::function<void(Time time, const CurrentValues& values, std::uint64_t packet)>;
    void walk(const Recording& recording, const Take& take);

private:
    struct Held {
        FieldIndex field;
        ListId list; ///< 0: none
        EntryId entry;
        Time start;
        Time end;
        std::uint64_t packet;
        FieldValue value;
    };
    using Range = std::pair<std::vector<Held>::iterator, std::vector<Held>::iterator>;

    void read(const Recording& recording);
    Held heldOf(FieldIndex field, const Recording& recording, StoredValue value);
    ListId listOf(FieldIndex field);
    void walkStretch(const Range& stretch, Time tick, const Take& take);
    void show(Time tick);
    Time readAt(const Held& held, Time tick) const;

    StoredRecordings& _store;
    FieldTable& _fields;
    EntryTable& _entries;
    CurrentValues _values;
    std::vector<FieldIndex> _wanted;
    std::vector<std::string> _names; ///< of the wanted fields
    bool _isOfPackets = false; ///< the recording has the values of each packet, not of the ticks
    std::vector<Held> _held;   ///< of the recording, in the order of packets
    std::map<std::pair<EntryId, FieldIndex>, const Held*> _current;
};

} // namespace pallax
