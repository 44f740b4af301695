#include "telephony/simulator/gsm/NetworkRecords.h"

#include "telephony/simulator/RecordWriter.h"

namespace pallax::gsm {

namespace {

constexpr std::size_t kStateLength = 16;
constexpr unsigned kNibble = 4;

unsigned digit(unsigned number, unsigned weight) {
    constexpr unsigned kBase = 10;
    return number / weight % kBase;
}

} // namespace

//   byte  width  0x7132, 16 bytes
//   13    8      service state
//   14    8      selection mode of the network
void encode(const Registration& registration, ByteBuffer& out) {
    RecordWriter(out, 0x7132)
        .u8(static_cast<unsigned>(registration.state))
        .u8(registration.selectionMode)
        .padTo(kStateLength);
}

//   byte  width  0x7131, 16 bytes
//   13    8      state
//   14    8      sub-state
//   15    8      status of the location update
void encode(const MobilityState& state, ByteBuffer& out) {
    RecordWriter(out, 0x7131).u8(state.state).u8(state.subState).u8(state.updateStatus);
}

//   byte  width  0x7130, 16 bytes
//   13    8      state
//   14    8      sub-state
//   15    8      status of the routing-area update
void encode(const PacketMobilityState& state, ByteBuffer& out) {
    RecordWriter(out, 0x7130).u8(state.state).u8(state.subState).u8(state.updateStatus);
}

//   byte  width  0x7135, 32 bytes
//   13    8      network operating mode
//   14    8      service type
//   15    24     network: digits in pairs, the low half first; 15 for a missing one
//   18    16     location area, high byte first
//   20    8      routing area
void encode(const ServingPlmn& plmn, ByteBuffer& out) {
    constexpr std::size_t kLength = 32;
    constexpr unsigned kNoDigit = 15;
    constexpr unsigned kByte = 8;
    RecordWriter(out, 0x7135)
        .u8(plmn.operatingMode)
        .u8(plmn.serviceType)
        .u8(digit(plmn.country, 100) | digit(plmn.country, 10) << kNibble)
        .u8(digit(plmn.country, 1) | kNoDigit << kNibble)
        .u8(digit(plmn.network, 10) | digit(plmn.network, 1) << kNibble)
        .u8(plmn.locationArea >> kByte)
        .u8(plmn.locationArea)
        .u8(plmn.routingArea)
        .padTo(kLength);
}

//   byte  width  0x7150
//   16    8      number of networks
//   17    48     the network: digits of country and network in turns
void encode(const EquivalentPlmn& plmn, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 16;
    RecordWriter record(out, 0x7150);
    record.padTo(kCountOffset).u8(1);
    for (const unsigned weight : {100U, 10U, 1U}) {
        record.u8(digit(plmn.country, weight)).u8(digit(plmn.network, weight));
    }
}

} // namespace pallax::gsm
