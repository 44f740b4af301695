#include "LogGenerator/C2K/LookupDisplay.h"

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/Records/DisplayAndSink.h"
#include "LogGenerator/Records/LayoutReader.h"

#include <array>
#include <charconv>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kSortedMark = "_sorted";

} // namespace

LookupDisplay::LookupDisplay(std::span<const CodeLayout* const> codes) {
    FieldId row = 0;
    for (const CodeLayout* code : codes) {
        _codes.push_back({code, row, isReadLate(*code)});
        row += static_cast<FieldId>(rowCount(*code));
    }
    _places.resize(row);
    _times.setRows(0, row);
}

void LookupDisplay::take(std::size_t index, const LogRecord& packet, const DictionaryRef& lookup,
                         Dictionary& state) {
    Code& code = _codes[index];
    if (!code.isReadLate) {
        return readNow(code, packet, lookup, state);
    }
    if (_sink != nullptr) {
        LayoutReader(*_sink, _memory, code.firstRow).read(*code.layout, packet);
    }
    code.packet.assign(packet.bytes().begin(), packet.bytes().end());
    code.lookup = lookup;
    code.time = _packetTime;
}

void LookupDisplay::readNow(const Code& code, const LogRecord& packet, const DictionaryRef& lookup,
                            Dictionary& state) {
    usePlacesOf(lookup);
    _memory.state = &state;
    _times.setPacket(_packetTime);
    if (_sink == nullptr) {
        LayoutReader(*this, _memory, code.firstRow).read(*code.layout, packet);
    } else {
        DisplayAndSink both(*this, *_sink);
        LayoutReader<SampleSink>(both, _memory, code.firstRow).read(*code.layout, packet);
    }
    _memory.state = nullptr;
}

void LookupDisplay::bringUpToDate() {
    for (Code& code : _codes) {
        if (const DictionaryRef lookup = std::exchange(code.lookup, nullptr)) {
            usePlacesOf(lookup);
            _times.setPacket(code.time);
            LayoutReader(*this, _memory, code.firstRow).read(*code.layout, LogRecord(code.packet));
        }
    }
}

void LookupDisplay::usePlacesOf(const DictionaryRef& lookup) {
    if (lookup != _lookup) {
        findPlaces(lookup);
    }
}

void LookupDisplay::findPlaces(const DictionaryRef& lookup) {
    _lookup = lookup;
    const auto placesOf = [&lookup](std::string_view name) {
        return lookup != nullptr ? lookupPlaces(name, *lookup) : std::vector<LookupPlace>();
    };
    for (const Code& code : _codes) {
        FieldId row = code.firstRow;
        const auto findAll = [&](std::span<const Field> fields, std::span<const ListLayout> lists) {
            for (const Field& field : fields) {
                _places[row++] = placesOf(field.key);
            }
            row += static_cast<FieldId>(rowCount(lists));
        };
        findAll(code.layout->fields, code.layout->lists);
        for (const SubpacketLayout& subpacket : code.layout->subpackets) {
            findAll(subpacket.fields, subpacket.lists);
        }
    }
}

std::vector<LookupDisplay::PlaceRead> LookupDisplay::placesRead() const {
    std::vector<PlaceRead> read;
    const auto add = [&read](const std::vector<LookupPlace>& places, std::optional<Time> time) {
        for (const LookupPlace& place : places) {
            if (time) {
                read.push_back({place, *time});
            }
        }
    };
    for (FieldId row = 0; row < _places.size(); ++row) {
        add(_places[row], _times.ofRow(row));
    }
    for (const Code& code : _codes) {
        for (const ListLayout& list : code.layout->lists) {
            if (_lookup != nullptr) {
                add(lookupPlaces(list.key, *_lookup), _times.ofKey(list.key));
            }
        }
    }
    return read;
}

void LookupDisplay::sample(const Sample& sample) {
    if (_pilots != nullptr) {
        PropertyList value;
        sample.value.showIn(value);
        _pilots->set(std::exchange(_pilot, {}), std::move(value));
        return;
    }
    _times.noteRow(sample.id);
    for (const LookupPlace& place : _places[sample.id]) {
        PropertyList value;
        sample.value.showIn(value);
        place.display->set(place.key, std::move(value));
    }
}

void LookupDisplay::beginList(const SampleList& list) {
    _list = list.layout;
    _pilots = std::make_shared<Dictionary>();
    _pilots->setFixed(kSortedMark, Text::fixed(kSortedMark));
}

void LookupDisplay::beginEntry(std::size_t index, std::int64_t name) {
    constexpr std::size_t kDigits = 20; // for any 64-bit number
    std::array<char, 2 * kDigits + 1> key{};
    char* end = std::to_chars(key.data(), key.data() + kDigits, index).ptr;
    *end++ = ';';
    end = std::to_chars(end, key.data() + key.size(), name).ptr;
    _pilot.assign(key.data(), end);
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
        _times.noteKey(_list->key);
    }
}

} // namespace pallax
