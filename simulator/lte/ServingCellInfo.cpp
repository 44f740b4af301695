#include "simulator/RecordWriter.h"
#include "simulator/lte/LteRecords.h"

namespace pallax::lte {

//   byte  width  0xB0C2, 38 bytes
//   13    8      version
//   14    16     physical cell ID
//   16    16     downlink EARFCN
//   18    16     uplink EARFCN
//   20    8      downlink resource blocks
//   21    8      uplink resource blocks
//   22    32     cell identity
//   26    16     tracking area
//   28    32     band
void encode(const ServingCellInfo& info, ByteBuffer& out) {
    constexpr unsigned kVersion = 2;
    constexpr std::size_t kLength = 38;
    RecordWriter(out, 0xB0C2)
        .u8(kVersion)
        .u16(info.physicalCellId)
        .u16(info.downlinkEarfcn)
        .u16(info.uplinkEarfcn)
        .u8(info.downlinkResourceBlocks)
        .u8(info.uplinkResourceBlocks)
        .u32(info.cellIdentity)
        .u16(info.trackingArea)
        .u32(info.band)
        .padTo(kLength);
}

} // namespace pallax::lte
