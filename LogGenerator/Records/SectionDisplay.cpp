#include "LogGenerator/Records/SectionDisplay.h"

#include "LogGenerator/Records/ArrayLock.h"
#include "LogGenerator/Records/Base.h"

#include <utility>

namespace pallax {

void SectionDisplay::setSection(const PropertyList& section) {
    _keys = section.dictionary();
    _list = section.array();
}

bool SectionDisplay::shows(const PropertyList& value) const {
    return _keys != nullptr ? value.dictionary() == _keys
                            : _list != nullptr && value.array() == _list;
}

void SectionDisplay::keep(const CodeLayout& code, FieldId firstRow, unsigned shape, Time packet,
                          const LogRecord& record) {
    if (_code != &code || _shape != shape) {
        bringUpToDate();
    }
    _kept.assign(record.bytes().begin(), record.bytes().end());
    _code = &code;
    _firstRow = firstRow;
    _shape = shape;
    _packet = packet;
    if (!_isLate) {
        bringUpToDate();
    }
}

void SectionDisplay::bringUpToDate() {
    if (const CodeLayout* code = std::exchange(_code, nullptr)) {
        _times.setPacket(_packet);
        LayoutReader(*this, _memory, _firstRow).read(*code, LogRecord(_kept));
    }
}

void SectionDisplay::sample(const Sample& sample) {
    if (_open.empty()) {
        if (_keys != nullptr) {
            sample.value.showIn(_keys->valueToSet(sample.field.key));
            _times.noteRow(sample.id);
        }
        return;
    }
    Open& open = _open.back();
    if (sample.field.key.empty()) {
        sample.value.showIn(open.list.emplace_back());
        open.isPlain = true;
        return;
    }
    sample.value.showIn(entryOf(open).valueInOrder(sample.field.key));
}

void SectionDisplay::keyRemoved(std::string_view key) {
    if (_keys != nullptr) {
        (void)_keys->remove(key);
        _times.noteKey(key);
    }
}

void SectionDisplay::beginList(const SampleList& list) {
    if (_open.empty() && list.key.empty() && _list != nullptr) {
        _spares.clear();
        ArrayLock::lockArray();
        _spares.swap(*_list);
        ArrayLock::unlockArray();
    }
    _open.emplace_back();
    _open.back().key = list.key;
    _open.back().list.reserve(list.count);
}

void SectionDisplay::endList() {
    Open ended = std::move(_open.back());
    _open.pop_back();
    if (!_open.empty()) {
        entryOf(_open.back()).valueInOrder(ended.key) = std::move(ended.list);
    } else if (!ended.key.empty()) {
        if (_keys != nullptr) {
            _keys->setFixed(ended.key, std::move(ended.list));
            _times.noteKey(ended.key);
        }
    } else if (_list != nullptr) {
        Base::replaceArray(*_list, std::move(ended.list));
        _times.noteKey({});
    }
}

void SectionDisplay::beginEntry(std::size_t /*index*/, std::int64_t /*name*/) {
    _open.back().isPlain = false;
}

void SectionDisplay::endEntry() {
    Open& open = _open.back();
    if (!open.isPlain) {
        entryOf(open).dropRest();
        open.list.emplace_back(std::move(open.entry));
    }
    open.entry.reset();
}

Dictionary& SectionDisplay::entryOf(Open& open) {
    if (open.entry == nullptr) {
        open.entry = spareEntry();
        open.entry->startOver();
    }
    return *open.entry;
}

DictionaryRef SectionDisplay::spareEntry() {
    while (!_spares.empty()) {
        const PropertyList spare = std::move(_spares.back());
        _spares.pop_back();
        DictionaryRef entry = spare.dictionary();
        constexpr long kSpareAndEntry = 2;
        if (entry != nullptr && entry.use_count() == kSpareAndEntry) {
            return entry;
        }
    }
    return std::make_shared<Dictionary>();
}

} // namespace pallax
