#include "simulator/Measurement.h"
#include "simulator/RecordWriter.h"
#include "simulator/lte/LteRecords.h"

namespace pallax::lte {

namespace {

constexpr unsigned kNoThreshold = 32;

/// In steps of 2 dB, in 5 bits.
unsigned rawThreshold(int threshold_db) {
    return threshold_db < 0 ? kNoThreshold : rawOf(threshold_db, 0, 2, 5);
}

} // namespace

//   byte  bit  width  0xB17F, 33 bytes
//   13    0    8      version
//   17    0    16     EARFCN
//   19    0    9      physical cell ID
//   20    1    4      priority of the serving layer
//   21    0    9      measured RSRP, quarters of a dB above -140 dBm
//   22    1    9      average RSRP, the same
//   23    2    7      measured RSRQ, quarters of a dB above -30 dB
//   24    1    7      average RSRQ, the same
//   25    0    9      measured RSSI, halves of a dB above -140 dBm
//   26    1    6      Qrxlevmin, steps of 2 dB above -140 dBm
//   26    7    7      largest power in the cell, dB above -30 dBm
//   27    6    6      largest power of the phone, the same
//   29    0    7      Srxlev, dB above -30
//   29    7    6      DRX cycles with a negative Srxlev
//   30    5    6      threshold for intra-frequency search, steps of 2 dB, 32 for none
//   31    3    6      threshold for other searches, the same
//   32    1    1      measurement rules updated
//   32    2    4      measurement rules
void encode(const IdleServing& serving, ByteBuffer& out) {
    constexpr unsigned kVersion = 3;
    constexpr std::size_t kLength = 33;
    RecordWriter record(out, 0xB17F);
    record.u8(kVersion).padTo(kLength);
    record.bits(17, 0, 16, serving.earfcn);
    record.bits(19, 0, 9, serving.physicalCellId);
    record.bits(20, 1, 4, serving.layerPriority);
    record.bits(21, 0, 9, rawOf(serving.rsrp_dbm, -140, 0.25, 9));
    record.bits(22, 1, 9, rawOf(serving.averageRsrp_dbm, -140, 0.25, 9));
    record.bits(23, 2, 7, rawOf(serving.rsrq_db, -30, 0.25, 7));
    record.bits(24, 1, 7, rawOf(serving.averageRsrq_db, -30, 0.25, 7));
    record.bits(25, 0, 9, rawOf(serving.rssi_dbm, -140, 0.5, 9));
    record.bits(26, 1, 6, rawOf(serving.qrxlevmin_dbm, -140, 2, 6));
    record.bits(26, 7, 7, rawOf(serving.largestPower_dbm, -30, 1, 7));
    record.bits(27, 6, 6, rawOf(serving.ownLargestPower_dbm, -30, 1, 6));
    record.bits(29, 0, 7, rawOf(serving.srxlev_db, -30, 1, 7));
    record.bits(29, 7, 6, serving.cyclesBelow);
    record.bits(30, 5, 6, rawThreshold(serving.intraSearch_db));
    record.bits(31, 3, 6, rawThreshold(serving.nonIntraSearch_db));
    record.bits(32, 1, 1, serving.rulesUpdated ? 1 : 0);
    record.bits(32, 2, 4, serving.rules);
}

} // namespace pallax::lte
