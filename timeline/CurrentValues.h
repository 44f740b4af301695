#pragma once

#include "LogGenerator/Records/Sample.h"
#include "timeline/EntryTable.h"
#include "timeline/FieldTable.h"

#include <cmath>
#include <cstddef>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <vector>

namespace pallax {

/// The latest value of a field.
struct FieldValue {
    PropertyList shown; ///< null: none
    double number = NAN;
    std::optional<std::int64_t> raw = std::nullopt; ///< the number in the record
    Time read = {};                                 ///< of the packet

    bool isEmpty() const { return shown.isNull(); }
    std::string text() const { return shown.string().value_or(shown.description()); }
    friend bool operator==(const FieldValue& a, const FieldValue& b) { return a.shown == b.shown; }
};

/// The values of one entry of a list.
struct EntryValues {
    EntryId entry = kNoEntry;
    std::vector<std::pair<FieldIndex, FieldValue>> values;

    /// Null if the entry has none.
    const FieldValue* value(FieldIndex field) const;
};

/// The current values of all fields after a packet: a sink that keeps the latest sample of each
/// field and the entries of each list. It can be copied.
class CurrentValues final : public SampleSink {
public:
    /// Gets each value when it is read; those of an entry at its end, when its identity is known.
    class Listener {
    public:
        virtual ~Listener() = default;
        virtual void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) = 0;
        /// Gets the values of an entry at once.
        virtual void entryRead(const EntryValues& entry) {
            for (const auto& [field, value] : entry.values) {
                valueRead(field, entry.entry, value);
            }
        }
        virtual void valueRemoved(FieldIndex field) = 0;
        /// The list begins anew or is gone.
        virtual void listReplaced(ListId list) = 0;
    };

    /// Both must outlive it. They may grow during a packet.
    CurrentValues(FieldTable& fields, EntryTable& entries) : _fields(&fields), _entries(&entries) {}
    void setListener(Listener* listener) { _listener = listener; }
    /// Forgets all values.
    void clear();
    /// Takes the values of another one, but keeps its listener.
    void take(const CurrentValues& other);

    // From elsewhere than records, without a listener: `beginReplacing` forgets all values.
    void beginReplacing(Time time);
    void replace(FieldIndex field, FieldValue value);
    /// Adds an entry to a list, which is in no other.
    void replace(ListId list, EntryValues entry);

    /// Nothing for a field in a list, and for one without a value.
    const FieldValue* value(FieldIndex field) const {
        return field < _values.size() && !_values[field].isEmpty() ? &_values[field] : nullptr;
    }
    const FieldValue* value(std::string_view fieldName) const;
    const FieldTable& fields() const { return *_fields; }
    const EntryTable& entries() const { return *_entries; }
    /// The time of the latest packet.
    Time time() const { return _time; }
    std::size_t fieldCount() const { return _values.size(); }
    /// Calls `visit` with each entry (EntryValues) of each list, in the order of the lists.
    template <class Visit>
    void forEachEntry(const Visit& visit) const {
        for (const auto& list : _lists) {
            for (std::size_t index = 0; index < list.count; ++index) {
                visit(list.slots[index].held);
            }
        }
    }
    /// The entry at these places in the lists around a field, of lists in lists the outer one
    /// first. Null if there is none, or if no entry of the list has the field.
    const EntryValues* entryAt(FieldIndex field, std::span<const std::size_t> places) const;
    std::size_t bytes() const;

    void sample(const Sample& sample) override;
    void keyRemoved(std::string_view key) override;
    void beginSection(std::string_view section) override { _section = section; }
    void beginPacket(const SamplePacket& packet) override {
        _section = {};
        _time = packet.time;
        _open.clear(); // a record may have thrown in a list
    }
    void beginList(const SampleList& list) override;
    void endList() override;
    void beginEntry(std::size_t index, std::int64_t name) override;
    void endEntry() override;

private:
    /// The place of an entry in its list. The identity is worked out anew only when it may differ
    /// from that of the entry which was here before.
    struct Slot {
        EntryValues held;
        EntryId known = kNoEntry; ///< what it was the last time, without the count of `again`
        EntryId outer = kNoEntry;
        std::size_t index = 0;
        std::int64_t name = 0;
    };
    struct List {
        ListId id = 0;
        std::size_t outer = 0; ///< the place of the outer list, or kNone
        std::vector<Slot> slots;
        std::size_t count = 0; ///< of `slots` that are in the list
    };
    /// A list that has begun but not ended.
    struct Open {
        std::size_t list = 0;
        /// Of the entry. It does not move while the entry is open: its list gets no other entry.
        Slot* slot = nullptr;
        EntryId outer = kNoEntry;
        std::size_t index = 0; ///< of the entry, as the sink gets it
        std::int64_t name = 0;
        std::size_t held = 0; ///< values of the entry so far
        bool isIdentified = false;
        bool isAnother = false; ///< the identity differs from that of the slot
        bool isInEntry = false;
    };
    static constexpr std::size_t kNone = static_cast<std::size_t>(-1);

    void store(FieldValue& target, const Sample& sample) const;
    /// The slot at the last of the places; null if there is none.
    const Slot* slotAt(std::size_t list, std::span<const std::size_t> places) const;
    void sampleInEntry(Open& open, const Sample& sample);
    /// The place of a list with a layout, so that its name is looked up only once.
    struct Known {
        const ListLayout* layout;
        const char* section;
        std::size_t outer;
        std::size_t place;
    };

    std::size_t placeOf(const SampleList& list, std::size_t outer);
    std::size_t placeOf(ListId id, std::size_t outer);
    void empty(std::size_t place);
    void identify(Open& open);
    EntryId identified(const Open& open, const Slot& slot);
    std::string identityOf(const Open& open, const Slot& slot) const;
    std::optional<EntryTable::Numbers> numbersOf(const Open& open, const Slot& slot) const;

    FieldTable* _fields;
    EntryTable* _entries;
    Listener* _listener = nullptr;
    std::vector<FieldValue> _values; ///< by field
    std::vector<List> _lists;
    std::unordered_map<ListId, std::size_t> _places;
    std::vector<Known> _known;
    bool _hasInnerLists = false;
    std::vector<Open> _open;
    std::string_view _section;
    Time _time; ///< of the packet
};

} // namespace pallax
