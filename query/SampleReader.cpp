#include "query/SampleReader.h"

namespace pallax {

namespace {

/// So many that starting again costs little, and so few that the items stay in the caches.
constexpr std::size_t kItemsAtOnce = 512;

} // namespace

SampleReader::SampleReader(Timeline& timeline, const PacketRange& range,
                           std::optional<FieldIndex> field)
    : _range(range), _field(field), _values(timeline.fieldTable(), timeline.entryTable()) {
    _values.setListener(this);
    if (range.first <= range.last) {
        _replay = timeline.replayAt(range.first - 1);
        _reader = timeline.journal().reader(range.first);
    }
}

bool SampleReader::readMore() {
    _items.clear();
    _gone.clear();
    while (_replay && _items.size() + _gone.size() < kItemsAtOnce) {
        const auto packet = _reader->next();
        if (!packet || packet->number > _range.last) {
            _replay.reset();
            break;
        }
        _range.noteRead(packet->number);
        _packet = *packet;
        _place = 0;
        _replay->update(*packet, &_values);
    }
    return !_items.empty() || !_gone.empty() || _replay;
}

void SampleReader::valueRead(FieldIndex field, EntryId entry, const FieldValue& value) {
    const std::uint32_t place = _place++;
    if (!_field || *_field == field) {
        _items.push_back({_packet.number, _packet.time, field, entry, value, place});
    } else if (place == 0) {
        _gone.push_back({_items.size(), _packet.number, _packet.time, std::nullopt, 0});
    }
}

} // namespace pallax
