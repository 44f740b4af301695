#include "simulator/Measurement.h"
#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"
#include "simulator/cdma/Subpackets.h"

#include <algorithm>
#include <cmath>

namespace pallax::cdma {

namespace {

/// In steps of 0.334 dB above -63.248 dBm.
int rawGain(double level_dbm) {
    constexpr double kMiddleDbm = -63.248;
    constexpr double kStepDb = 0.334;
    return std::clamp(whole((level_dbm - kMiddleDbm) / kStepDb), -128, 127);
}

// The scale of energies in the active set: the share is 2^(2e - 3) E / (9 N^2 g) - 1/N.
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

} // namespace pallax::cdma
