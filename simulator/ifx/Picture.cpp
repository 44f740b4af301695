#include "simulator/ifx/Picture.h"

#include "simulator/ifx/BinaryObjectWriter.h"
#include "simulator/ifx/XmlObjectWriter.h"

namespace pallax::ifx {

namespace {

// A list begins with its header.
static_assert(1 + Picture::kMostNeighbours <= BinaryObjectWriter::kMostInContainer);
static_assert(1 + Picture::kMostHopping <= BinaryObjectWriter::kMostInContainer);

Word wordOf(RrState state) {
    switch (state) {
    case RrState::Off:
        return Word::Off;
    case RrState::Selection:
        return Word::CellSelection;
    case RrState::Establishment:
        return Word::ConnectionEstablishment;
    case RrState::Dedicated:
        return Word::Dedicated;
    case RrState::Release:
        return Word::ConnectionRelease;
    case RrState::Idle:
        break;
    }
    return Word::Idle;
}

/// Tells a writer of one of the forms what a picture holds. The modem wraps what has a unit or a
/// name into a dictionary of its own.
template <class Writer>
class Teller {
public:
    explicit Teller(Writer& writer) : _writer(writer) {}

    void tell(const Picture& picture) {
        _writer.beginDictionary();
        network(picture.isRegistered);
        _writer.key(Word::Rr);
        _writer.beginDictionary();
        _writer.key(Word::State);
        wrapped(Word::Name, wordOf(picture.state));
        _writer.endDictionary();
        serving(picture.serving);
        neighbours(picture.neighbours);
        _writer.key(Word::DedicatedChannel);
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
    template <class Number>
    void entry(Word key, Number number) {
        _writer.key(key);
        _writer.shortText(number);
    }
    void bsic(ColourCode code) {
        _writer.key(Word::Bsic);
        _writer.shortText(code.network, std::string_view(","), code.station);
    }
    void level(Word key, int level_dbm) {
        _writer.key(key);
        _writer.beginDictionary();
        _writer.key(Word::Value);
        _writer.shortText(level_dbm, std::string_view(" dBm"));
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
    _writer.key(Word::Network);
    _writer.beginDictionary();
    _writer.key(Word::Registered);
    if (isRegistered) {
        _writer.beginDictionary();
        entry(Word::Name, Word::SampleNet);
        entry(Word::Mcc, Word::Mcc262);
        entry(Word::Mnc, Word::Mnc42);
        _writer.endDictionary();
    } else {
        _writer.text(Word::No);
    }
    _writer.endDictionary();
}

template <class Writer>
void Teller<Writer>::serving(const ServingCell& cell) {
    _writer.key(Word::ServingCell);
    _writer.beginDictionary();
    entry(Word::Arfcn, cell.arfcn);
    bsic(cell.bsic);
    level(Word::RxLevel, cell.level_dbm);
    entry(Word::C1, cell.c1);
    _writer.key(Word::Area);
    _writer.beginDictionary();
    entry(Word::Lac, cell.locationArea);
    entry(Word::CellId, cell.cellId);
    _writer.endDictionary();
    _writer.endDictionary();
}

template <class Writer>
void Teller<Writer>::neighbours(std::span<const NeighbourCell> cells) {
    _writer.key(Word::NeighbourCells);
    _writer.beginArray();
    _writer.text(Word::NeighbourHeader);
    for (const NeighbourCell& cell : cells) {
        _writer.beginDictionary();
        entry(Word::Arfcn, cell.arfcn);
        if (cell.isRead) {
            bsic(cell.bsic);
            level(Word::RxLevel, cell.level_dbm);
        }
        _writer.endDictionary();
    }
    _writer.endArray();
}

template <class Writer>
void Teller<Writer>::dedicated(const DedicatedChannel& channel) {
    _writer.beginDictionary();
    _writer.key(Word::Channel);
    wrapped(Word::Type, channel.type == ChannelType::Traffic ? Word::TchF : Word::Sdcch8);
    entry(Word::TimeSlot, channel.timeSlot);
    entry(Word::TimingAdvance, channel.timingAdvance);
    entry(Word::RxQuality, channel.quality);
    level(Word::TxPower, channel.power_dbm);
    if (!channel.hopping.empty()) {
        _writer.key(Word::Hopping);
        _writer.beginArray();
        _writer.text(Word::HoppingHeader);
        for (const unsigned arfcn : channel.hopping) {
            _writer.shortText(arfcn);
        }
        _writer.endArray();
    }
    _writer.endDictionary();
}

} // namespace

void encode(const Picture& picture, ListForm form, ByteBuffer& out) {
    if (form == ListForm::Binary) {
        BinaryObjectWriter writer;
        Teller(writer).tell(picture);
        writer.finish(out);
    } else {
        XmlObjectWriter writer;
        Teller(writer).tell(picture);
        writer.finish(out);
    }
}

} // namespace pallax::ifx
