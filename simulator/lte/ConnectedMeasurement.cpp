#include "simulator/Measurement.h"
#include "simulator/RecordWriter.h"
#include "simulator/lte/LteRecords.h"

namespace pallax::lte {

namespace {

void putLevels(RecordWriter& record, const ConnectedCell& cell) {
    record.u16(rawOf(cell.rsrp_dbm, -140, 0.25, 16)).u16(rawOf(cell.rsrq_db, -20, 0.125, 16));
}

} // namespace

//   byte     width  0xB179
//   13       32     version
//   17       16     EARFCN
//   19       16     physical cell ID of the serving cell
//   21       16     subframe number
//   23       16     its RSRP, quarters of a dB above -140 dBm
//   25       16     its RSRQ, eighths of a dB above -20 dB
//   27       8      number N of measured neighbours
//   28       8      number of detected cells
//   29       48     each measured neighbour: physical cell ID, RSRP, RSRQ
//   29 + 6N  16     each detected cell: physical cell ID
void encode(const ConnectedMeasurement& measurement, ByteBuffer& out) {
    constexpr std::uint32_t kVersion = 1;
    RecordWriter record(out, 0xB179);
    record.u32(kVersion).u16(measurement.earfcn).u16(measurement.serving.physicalCellId);
    record.u16(measurement.subframe);
    putLevels(record, measurement.serving);
    record.u8(static_cast<unsigned>(measurement.measured.size()));
    record.u8(static_cast<unsigned>(measurement.detected.size()));
    for (const ConnectedCell& cell : measurement.measured) {
        record.u16(cell.physicalCellId);
        putLevels(record, cell);
    }
    for (const unsigned cell : measurement.detected) {
        record.u16(cell);
    }
}

} // namespace pallax::lte
