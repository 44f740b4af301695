#include "LogGenerator/C2K/LookupDisplay.h"

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/Records/LayoutReader.h"

#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kSortedMark = "_sorted";

} // namespace

LookupDisplay::LookupDisplay(std::span<const CodeLayout* const> codes) {
    for (const CodeLayout* code : codes) {
        _codes.push_back({code, isReadLate(*code)});
    }
}

void LookupDisplay::take(std::size_t index, const LogRecord& packet, const DictionaryRef& lookup,
                         Dictionary& state) {
    Code& code = _codes[index];
    if (!code.isReadLate) {
        return read(*code.layout, packet, lookup.get(), &state);
    }
    code.packet.assign(packet.bytes().begin(), packet.bytes().end());
    code.lookup = lookup;
}

void LookupDisplay::bringUpToDate() {
    for (Code& code : _codes) {
        if (const DictionaryRef lookup = std::exchange(code.lookup, nullptr)) {
            read(*code.layout, LogRecord(code.packet), lookup.get(), nullptr);
        }
    }
}

void LookupDisplay::read(const CodeLayout& code, const LogRecord& packet, const Dictionary* lookup,
                         Dictionary* state) {
    _lookup = lookup;
    _memory.state = state;
    LayoutReader(*this, _memory, 0).read(code, packet);
}

void LookupDisplay::sample(const Sample& sample) {
    PropertyList value;
    sample.value.showIn(value);
    if (_pilots != nullptr) {
        _pilots->set(_pilot, std::move(value));
    } else if (_lookup != nullptr) {
        setLookupValue(sample.field.key, value, *_lookup);
    }
}

void LookupDisplay::beginList(const SampleList& list) {
    _list = list.layout;
    _pilots = std::make_shared<Dictionary>();
    _pilots->setFixed(kSortedMark, Text::fixed(kSortedMark));
}

void LookupDisplay::beginEntry(std::size_t index, std::int64_t name) {
    _pilot = std::to_string(index) + ";" + std::to_string(name);
}

void LookupDisplay::endList() {
    const DictionaryRef pilots = std::exchange(_pilots, nullptr);
    constexpr std::size_t kMarkAlone = 1;
    const bool isEmpty = pilots->size() == kMarkAlone;
    const PropertyList shown = isEmpty && !_list->ifEmpty.empty()
                                   ? PropertyList(Text::fixed(_list->ifEmpty))
                                   : PropertyList(pilots);
    if (_lookup != nullptr) {
        setLookupValue(_list->key, shown, *_lookup);
    }
}

} // namespace pallax
