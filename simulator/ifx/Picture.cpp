#include "simulator/ifx/Picture.h"

#include "plist/XmlStream.h"
#include "simulator/ifx/BinaryMessage.h"

#include <concepts>
#include <string>

namespace pallax::ifx {

namespace {

Word wordOf(RrState state) {
    switch (state) {
    case RrState::Off:
        return "Off";
    case RrState::Selection:
        return "Cell Selection";
    case RrState::Establishment:
        return "Connection Establishment";
    case RrState::Dedicated:
        return "Dedicated";
    case RrState::Release:
        return "Connection Release";
    case RrState::Idle:
        break;
    }
    return "Idle";
}

/// Feeds the content of a picture to a writer of one of the forms. The modem wraps values with a
/// unit or a name in a dictionary of their own.
template <class Writer>
class Teller {
public:
    explicit Teller(Writer& writer) : _writer(writer) {}

    void tell(const Picture& picture) {
        _writer.beginDictionary();
        network(picture.isRegistered);
        _writer.key("RR");
        _writer.beginDictionary();
        _writer.key("State");
        wrapped("Name", wordOf(picture.state));
        _writer.endDictionary();
        serving(picture.serving);
        neighbours(picture.neighbours);
        _writer.key("Dedicated Channel");
        if (picture.dedicated) {
            dedicated(*picture.dedicated);
        } else {
            _writer.emptyDictionary();
        }
        _writer.endDictionary();
    }

private:
    void wrapped(Word key, Word value) {
        _writer.beginDictionary();
        entry(key, value);
        _writer.endDictionary();
    }
    void entry(Word key, Word value) {
        _writer.key(key);
        _writer.text(value);
    }
    void entry(Word key, std::integral auto number) { entry(key, std::to_string(number)); }
    void entry(Word key, const std::same_as<std::string> auto& text) {
        _writer.key(key);
        _writer.text(text);
    }
    void bsic(ColourCode code) {
        std::string text = std::to_string(code.network);
        text += ',';
        text += std::to_string(code.station);
        entry("BSIC", text);
    }
    void level(Word key, int level_dbm) {
        _writer.key(key);
        _writer.beginDictionary();
        entry("Value", std::to_string(level_dbm) + " dBm");
        _writer.endDictionary();
    }

    void network(bool isRegistered);
    void serving(const ServingCell& cell);
    void neighbours(std::span<const NeighbourCell> cells);
    void dedicated(const DedicatedChannel& channel);

    Writer& _writer;
};

template <class Writer>
void Teller<Writer>::network(bool isRegistered) {
    _writer.key("Network");
    _writer.beginDictionary();
    _writer.key("Registered");
    if (isRegistered) {
        _writer.beginDictionary();
        entry("Name", "Sample Net");
        entry("MCC", "262");
        entry("MNC", "42");
        _writer.endDictionary();
    } else {
        _writer.text(Word("No"));
    }
    _writer.endDictionary();
}

template <class Writer>
void Teller<Writer>::serving(const ServingCell& cell) {
    _writer.key("Serving Cell");
    _writer.beginDictionary();
    entry("ARFCN", cell.arfcn);
    bsic(cell.bsic);
    level("Rx Level", cell.level_dbm);
    entry("C1", cell.c1);
    _writer.key("Area");
    _writer.beginDictionary();
    entry("LAC", cell.locationArea);
    entry("Cell ID", cell.cellId);
    _writer.endDictionary();
    _writer.endDictionary();
}

template <class Writer>
void Teller<Writer>::neighbours(std::span<const NeighbourCell> cells) {
    _writer.key("Neighbour Cells");
    _writer.beginArray();
    _writer.text(Word("ARFCN, BSIC, Rx Level"));
    for (const NeighbourCell& cell : cells) {
        _writer.beginDictionary();
        entry("ARFCN", cell.arfcn);
        if (cell.isRead) {
            bsic(cell.bsic);
            level("Rx Level", cell.level_dbm);
        }
        _writer.endDictionary();
    }
    _writer.endArray();
}

template <class Writer>
void Teller<Writer>::dedicated(const DedicatedChannel& channel) {
    _writer.beginDictionary();
    _writer.key("Channel");
    wrapped("Type", channel.type == ChannelType::Traffic ? Word("TCH/F") : Word("SDCCH/8"));
    entry("Time Slot", channel.timeSlot);
    entry("Timing Advance", channel.timingAdvance);
    entry("Rx Quality", channel.quality);
    level("Tx Power", channel.power_dbm);
    if (!channel.hopping.empty()) {
        _writer.key("Hopping");
        _writer.beginArray();
        _writer.text(Word("MAIO 3, HSN 17"));
        for (const unsigned arfcn : channel.hopping) {
            _writer.text(std::to_string(arfcn));
        }
        _writer.endArray();
    }
    _writer.endDictionary();
}

} // namespace

void encode(const Picture& picture, ListForm form, ByteBuffer& out) {
    const auto writeTo = [&](auto writer) {
        Teller(writer).tell(picture);
        const std::string_view message = writer.finish();
        out.assign(message.begin(), message.end());
    };
    if (form == ListForm::Binary) {
        writeTo(BinaryMessage());
    } else {
        writeTo(XmlStream());
    }
}

} // namespace pallax::ifx
