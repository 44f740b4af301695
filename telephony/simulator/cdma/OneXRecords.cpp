#include "telephony/simulator/Measurement.h"
#include "telephony/simulator/RecordWriter.h"
#include "telephony/simulator/cdma/CdmaRecords.h"

#include <algorithm>
#include <cmath>

namespace pallax::cdma {

namespace {

//   byte  width  head of a record of subpackets
//   14    8      number of subpackets
//   17           subpackets, each with its number (8), a byte, and its size with this header (16)
constexpr std::size_t kFirstSubpacket = 17;

void putHead(RecordWriter& record, unsigned count) {
    record.u8(1).u8(count).padTo(kFirstSubpacket);
}

RecordWriter& subpacket(RecordWriter& record, unsigned number, std::size_t size) {
    return record.u8(number).u8(1).u16(static_cast<unsigned>(size));
}

/// In steps of 0.334 dB above -63.248 dBm.
int rawGain(double level_dbm) {
    constexpr double kMiddleDbm = -63.248;
    constexpr double kStepDb = 0.334;
    return std::clamp(whole((level_dbm - kMiddleDbm) / kStepDb), -128, 127);
}

// The scale of the energies of the active set: 2^(2e - 3) E / (9 N^2 g) - 1/N is the part.
constexpr unsigned kLength = 64; // N
constexpr unsigned kGain = 1;    // g
constexpr unsigned kExponent = 2;

unsigned rawEnergy(double part_db) {
    constexpr double kUnit = 9.0 * kLength * kLength * kGain / (1U << (2 * kExponent - 3));
    return rawOf((std::pow(10.0, part_db / 10) + 1.0 / kLength) * kUnit, 0, 1, 16);
}

//   byte  width  active set, with one path for each pilot
//   4     16     N
//   6     8      g
//   7     8      e
//   8     8      number of pilots
//   9     8      number of paths
//   10    16     PN of the reference pilot
//   12    160    each pilot: PN (16), 14 bytes, energy (16), 2 bytes
void putActiveSet(RecordWriter& record, std::span<const Pilot> pilots) {
    constexpr std::size_t kHead = 12;
    constexpr std::size_t kPilot = 20;
    constexpr std::size_t kBeforeEnergy = 14;
    subpacket(record, 3, kHead + kPilot * pilots.size());
    record.u16(kLength).u8(kGain).u8(kExponent);
    record.u8(static_cast<unsigned>(pilots.size())).u8(1);
    record.u16(pilots.empty() ? 0 : pilots.front().pn);
    for (const Pilot& pilot : pilots) {
        record.u16(pilot.pn).skip(kBeforeEnergy).u16(rawEnergy(pilot.part_db)).skip(2);
    }
}

} // namespace

//   subpacket  byte  width  0x119C
//   1          4     8      state
//   2          4     16     band classes of both receivers
//   2          6     32     their channels
//   2          10    16     their levels
//   2          12    16     transmit level, tenths of a dBm
//   3                       active set
//   4                       fingers, which are not shown
void encode(const OneXStatus& status, ByteBuffer& out) {
    constexpr std::size_t kStateSize = 8;
    constexpr std::size_t kRadioSize = 14;
    constexpr std::size_t kFingersSize = 36;
    constexpr std::size_t kHeader = 4;
    constexpr int kTenths = 10;
    RecordWriter record(out, 0x119C);
    putHead(record, 4);
    subpacket(record, 1, kStateSize).u8(static_cast<unsigned>(status.state)).skip(3);
    subpacket(record, 2, kRadioSize).u8(status.bandClass).u8(status.bandClass);
    record.u16(status.channel).u16(status.channel);
    record.s8(rawGain(status.receive0_dbm)).s8(rawGain(status.receive1_dbm));
    record.s16(whole(status.transmit_dbm * kTenths));
    putActiveSet(record, status.activeSet);
    subpacket(record, 4, kFingersSize).skip(kFingersSize - kHeader);
}

//   subpacket  byte  width  0x119D
//   11         24    8      the frame is in error
void encode(const TrafficFrame& frame, ByteBuffer& out) {
    constexpr unsigned kDemodulation = 11;
    constexpr std::size_t kSize = 28;
    constexpr std::size_t kBeforeError = 20;
    RecordWriter record(out, 0x119D);
    putHead(record, 1);
    subpacket(record, kDemodulation, kSize).skip(kBeforeError).u8(frame.inError ? 1 : 0).skip(3);
}

//   byte  width  0x134F
//   13    8      version
//   42    32     roaming indicator
//   46    32     type of the system: 2 for 1x
//   50    16     system identity
//   52    16     network identity
//   131   8      packet zone
//   133   8      protocol revision
//   184   16     base station
void encode(const SystemIdentity& identity, ByteBuffer& out) {
    constexpr unsigned kVersion = 2;
    constexpr unsigned kOneX = 2;
    constexpr std::size_t kRoamingOffset = 42;
    constexpr std::size_t kZoneOffset = 131;
    constexpr std::size_t kBaseStationOffset = 184;
    constexpr std::size_t kRecordLength = 190;
    RecordWriter(out, 0x134F)
        .u8(kVersion)
        .padTo(kRoamingOffset)
        .u32(identity.roaming)
        .u32(kOneX)
        .u16(identity.systemId)
        .u16(identity.networkId)
        .padTo(kZoneOffset)
        .u8(identity.packetZone)
        .u8(0)
        .u8(identity.protocolRevision)
        .padTo(kBaseStationOffset)
        .u16(identity.baseStation)
        .padTo(kRecordLength);
}

} // namespace pallax::cdma
