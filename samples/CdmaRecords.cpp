#include "samples/CdmaRecords.h"

#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/SubpacketBuilder.h"

namespace pallax {

namespace {

using doubles::packetOf;
using doubles::Record;
using doubles::Subpacket;

constexpr unsigned kCellularBand = 0;
constexpr unsigned kOneXChannel = 384;
constexpr unsigned kEvdoChannel = 466;
constexpr unsigned kUnlocked = 0xFFFF;

Subpacket oneXRadio(const OneXRadio& radio) {
    constexpr int kSecondReceiverLower = 3;
    return Subpacket(2)
        .u8(kCellularBand)
        .u8(kCellularBand)
        .u16(kOneXChannel)
        .u16(kOneXChannel)
        .s8(radio.receiveGain)
        .s8(radio.receiveGain - kSecondReceiverLower)
        .s16(radio.transmitGain_tenthDbm);
}

/// Pilots of the smallest size with one path.
Subpacket oneXActiveSet(const std::vector<CdmaPilot>& pilots) {
    constexpr std::size_t kFirstPilot = 12;
    constexpr std::size_t kPilotLength = 20;
    constexpr std::size_t kEnergy = 16;
    Subpacket activeSet(3);
    activeSet.u16(64).u8(1).u8(2); // the scale of the energies
    activeSet.u8(static_cast<unsigned>(pilots.size())).u8(1).u16(pilots.front().pn);
    std::size_t start = kFirstPilot;
    for (const CdmaPilot& pilot : pilots) {
        activeSet.putU16(start, pilot.pn).putU16(start + kEnergy, pilot.energy);
        start += kPilotLength;
        activeSet.padTo(start);
    }
    return activeSet;
}

} // namespace

ByteBuffer systemIdentityRecord(const CdmaSystem& system) {
    constexpr unsigned kVersion = 2;
    constexpr unsigned kSystemType = 2;
    constexpr unsigned kProtocolRevision = 6;
    return Record(0x134F)
        .u8(kVersion)
        .padTo(42)
        .u32(0) // roaming indicator: off
        .u32(kSystemType)
        .u16(system.systemId)
        .u16(system.networkId)
        .padTo(131)
        .u8(system.packetZone)
        .padTo(133)
        .u8(kProtocolRevision)
        .padTo(184)
        .u16(system.baseStation)
        .padTo(190)
        .prefixed();
}

ByteBuffer oneXStatusRecord(const OneXRadio& radio, const std::vector<CdmaPilot>& activeSet) {
    constexpr std::size_t kFingersLength = 36;
    return packetOf(0x119C,
                    {Subpacket(1).u8(static_cast<unsigned>(radio.state)).padTo(8), oneXRadio(radio),
                     oneXActiveSet(activeSet), Subpacket(4).padTo(kFingersLength)})
        .prefixed();
}

ByteBuffer trafficFrameRecord(bool inError) {
    return packetOf(0x119D, {Subpacket(11).padTo(24).u8(inError ? 1 : 0).padTo(28)}).prefixed();
}

ByteBuffer evdoStatusRecord(const EvdoRadio& radio) {
    constexpr int kSecondReceiverLower = 2;
    constexpr unsigned kColorCode = 63;
    return Record(0x1183)
        .u16(kEvdoChannel | kCellularBand << 11U)
        .s8(radio.receive_dbm)
        .s8(radio.receive_dbm - kSecondReceiverLower)
        .s8(radio.transmit_dbm)
        .u16(radio.servingPn)
        .padTo(36)
        .u8(static_cast<unsigned>(radio.state))
        .u8(static_cast<unsigned>(radio.session))
        .u16(radio.uati24)
        .u8(radio.uati24 >> 16U)
        .u8(kColorCode)
        .padTo(50)
        .prefixed();
}

ByteBuffer evdoActiveSetRecord(const std::vector<CdmaPilot>& pilots) {
    Record record(0x12B6);
    record.padTo(15).u8(static_cast<unsigned>(pilots.size())).padTo(25);
    for (const CdmaPilot& pilot : pilots) {
        record.u16(pilot.pn).u16(pilot.energy).u32(0).u32(0);
    }
    return record.prefixed();
}

ByteBuffer fingersRecord(const std::vector<CdmaPilot>& fingers) {
    Record record(0x108A);
    record.padTo(22).u8(static_cast<unsigned>(fingers.size()) + 1);
    for (const CdmaPilot& finger : fingers) {
        record.u16(finger.pn).u32(0).u16(finger.energy).u32(0).u16(0);
    }
    record.u16(kUnlocked).u32(0).u32(0).u32(0); // one finger more, which is locked to nothing
    return record.prefixed();
}

ByteBuffer forwardRateRecord(std::uint32_t sequence, const ForwardPackets& packets) {
    constexpr std::size_t kSmallCounter = 17 + 4 * 3;
    constexpr std::size_t kMiddleCounter = 17 + 4 * 27;
    constexpr std::size_t kLargeCounter = 17 + 4 * 45;
    Record record(0x1192);
    record.u32(sequence);
    record.padTo(kSmallCounter).u32(packets.small);
    record.padTo(kMiddleCounter).u32(packets.middle);
    record.padTo(kLargeCounter).u32(packets.large);
    return record.padTo(241).prefixed();
}

ByteBuffer reverseRateRecord(std::uint32_t sequence, std::uint32_t small, std::uint32_t large) {
    constexpr std::size_t kSmallCounter = 18 + 24 * 4;
    constexpr std::size_t kLargeCounter = 18 + 24 * 8;
    Record record(0x127E);
    record.u8(0).u32(sequence);
    record.padTo(kSmallCounter).u32(small);
    record.padTo(kLargeCounter).u32(large);
    return record.padTo(1750).prefixed();
}

} // namespace pallax
