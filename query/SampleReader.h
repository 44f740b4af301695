#pragma once

#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

namespace pallax {

/// Reads the samples of packets again, a few packets at a time.
class SampleReader final : private CurrentValues::Listener {
public:
    struct Item {
        std::uint64_t packet;
        Time time;
        FieldIndex field;
        EntryId entry; ///< kNoEntry outside lists
        FieldValue value;
        std::uint32_t place; ///< among all samples of the packet

        std::int64_t number() const { return numberInPacket(packet, place); }
    };
    /// A number that something in a packet alone has, by its place in it.
    static std::int64_t numberInPacket(std::uint64_t packet, std::uint64_t place) {
        constexpr unsigned kPlaceBits = 24;
        return static_cast<std::int64_t>(packet << kPlaceBits | place);
    }
    /// A list that begins anew, or a field that is gone, before the item with that index; or that a
    /// packet has samples of other fields than that of the reader.
    struct Gone {
        std::size_t before;
        std::uint64_t packet;
        Time time;
        std::optional<FieldIndex> field; ///< nothing: a list
        ListId list = 0;                 ///< 0: samples of other fields
    };

    /// Only the samples of `field`, if there is one. The timeline must outlive the reader.
    SampleReader(Timeline& timeline, const PacketRange& range,
                 std::optional<FieldIndex> field = std::nullopt);

    /// Replaces the items by those of the next packets, which may have none; false at the end.
    bool readMore();
    const std::vector<Item>& items() const { return _items; }
    const std::vector<Gone>& gone() const { return _gone; }

private:
    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override;
    void valueRemoved(FieldIndex field) override {
        _gone.push_back({_items.size(), _packet.number, _packet.time, field});
    }
    void listReplaced(ListId list) override {
        _gone.push_back({_items.size(), _packet.number, _packet.time, std::nullopt, list});
    }

    PacketRange _range;
    std::optional<FieldIndex> _field;
    std::unique_ptr<Replay> _replay; ///< null if there is nothing to read
    std::unique_ptr<PacketReader> _reader;
    CurrentValues _values;
    JournalPacket _packet;
    std::uint32_t _place = 0;
    std::vector<Item> _items;
    std::vector<Gone> _gone;
};

} // namespace pallax
