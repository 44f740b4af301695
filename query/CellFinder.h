#pragma once

#include "fields/CellFields.h"
#include "query/SampleReader.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <unordered_map>
#include <vector>

namespace pallax {

/// A cell in one role, in all packets that name it so.
struct FoundCell {
    CellRole role = CellRole::Serving;
    RadioSystem system = RadioSystem::Lte;
    std::string identity; ///< "PCI 275, EARFCN 1850"
    FieldValue code = {}; ///< empty if it is unknown
    FieldValue channel = {};
    Time first;
    Time last;
    std::uint64_t packet = 0; ///< the first one
    std::uint64_t readings = 0;
    bool hasLevel = false; ///< in the measure of its system
    double best = 0;
    double latest = 0;
};

/// Finds the cells in the samples of packets.
class CellFinder {
public:
    /// Both must outlive it.
    CellFinder(const FieldTable& fields, const EntryTable& entries);

    /// Takes the samples of whole packets.
    void take(const std::vector<SampleReader::Item>& items);
    /// In the order of their first packets.
    std::vector<FoundCell> found() && { return std::move(_found); }
    /// Those that were found so far; references do not stay valid.
    const std::vector<FoundCell>& soFar() const { return _found; }
    /// The place among them of the serving cell that was named last; nothing before the first.
    std::optional<std::size_t> serving() const { return _serving; }
    /// Whether a packet that reads this field can name a cell.
    bool isWatched(FieldIndex field) const {
        return field < _slots.size() && _slots[field] != kNone;
    }

private:
    static constexpr std::size_t kNone = static_cast<std::size_t>(-1);
    using Slot = std::size_t;

    /// A value that a rule asks for.
    struct Watched {
        FieldIndex field = 0;
        FieldValue latest = {};          ///< outside lists
        const FieldValue* now = nullptr; ///< read in the current packet, or in the current entry
    };
    struct Rule {
        const CellFields* fields = nullptr;
        bool isNamedByEntry = false;  ///< the code is the name of the entry
        bool isChannelBeside = false; ///< in the same section or list
        Slot code = kNone;
        Slot channel = kNone;
        Slot networkColour = kNone;
        Slot level = kNone;
        std::vector<Slot> area;
    };

    Slot slotOf(std::string_view field);
    void addRule(const CellFields& fields);
    void takePacket(std::span<const SampleReader::Item> items);
    void takeRules(const SampleReader::Item& item, EntryId entry);
    bool isReadNow(Slot slot) const;
    bool isNamedNow(const Rule& rule) const;
    /// The value if it was read now, else an empty one.
    FieldValue valueOf(Slot slot) const;
    FieldValue codeOf(const Rule& rule, EntryId entry) const;
    FieldValue channelOf(const Rule& rule) const;
    std::string identityOf(const Rule& rule, const FieldValue& code,
                           const FieldValue& channel) const;
    void note(const Rule& rule, const SampleReader::Item& item, EntryId entry);

    const FieldTable& _fields;
    const EntryTable& _entries;
    std::optional<std::size_t> _serving;
    std::vector<Rule> _rules;
    std::vector<Watched> _watched;
    std::vector<Slot> _slots; ///< by field
    std::vector<FoundCell> _found;
    std::unordered_map<std::string, std::size_t> _places; ///< by role, system and identity
};

} // namespace pallax
