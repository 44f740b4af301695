#include "timeline/SpanMaker.h"

#include <algorithm>
#include <utility>

namespace pallax {

void SpanMaker::beginPacket(std::uint64_t packet, Time time) {
    endReplaced();
    _packet = packet;
    _time = time;
}

void SpanMaker::valueRead(FieldIndex field, EntryId entry, const FieldValue& value,
                          std::uint32_t place) {
    const Key key = keyOf(field, entry);
    auto found = _open.find(key);
    if (found != _open.end() && !(found->second.span.value == value)) {
        end(found);
        found = _open.end();
    }
    if (found == _open.end()) {
        const ListId list = entry != kNoEntry ? _list : 0;
        found = _open.emplace(key, Open{{field, entry, value, _packet, place, _time, {}}, 0, list})
                    .first;
    }
    found->second.lastRead = _packet;
}

void SpanMaker::valueRemoved(FieldIndex field) {
    if (const auto found = _open.find(keyOf(field, kNoEntry)); found != _open.end()) {
        end(found);
    }
}

void SpanMaker::listReplaced(ListId list) {
    _list = list;
    _replaced.push_back(list);
}

void SpanMaker::endReplaced() {
    for (const ListId list : _replaced) {
        for (auto each = _open.begin(); each != _open.end();) {
            const auto open = each++;
            if (open->second.list == list && open->second.lastRead != _packet) {
                end(open);
            }
        }
    }
    _replaced.clear();
}

void SpanMaker::endUnread() {
    for (auto each = _open.begin(); each != _open.end();) {
        const auto open = each++;
        if (open->second.lastRead != _packet) {
            end(open);
        }
    }
}

void SpanMaker::endAll() {
    endReplaced();
    while (!_open.empty()) {
        end(_open.begin());
    }
}

void SpanMaker::end(Spans::iterator open) {
    Span& span = open->second.span;
    span.end = std::max(_time, span.start);
    _ended.push_back(std::move(span));
    _open.erase(open);
}

} // namespace pallax
