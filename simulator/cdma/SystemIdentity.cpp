#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"

namespace pallax::cdma {

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
