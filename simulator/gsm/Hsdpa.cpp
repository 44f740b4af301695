#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

namespace {

void putProcesses(RecordWriter& record, std::span<const HarqProcess> processes) {
    for (const HarqProcess& process : processes) {
        record.u8(process.id).u32(process.receivedBits);
        record.u16(process.newTransmissions).u16(process.blockErrors);
    }
}

} // namespace

//   byte        bit  width  0x4221
//   13          0    8      version
//   14          0    10     sub-frames
//   15          2    2      carriers
//   16          0    8      number P of primary processes
//   17          0    8      number of secondary processes
//   18          0    72     each primary process: identity (8), bits received (32), new
//                           transmissions (16), block errors (16)
//   18 + 162P   0    72     each secondary process, the same
void encode(const Hsdpa& hsdpa, ByteBuffer& out) {
    constexpr unsigned kCarriersShift = 10;
    constexpr std::size_t kProcessesStart = 18;
    constexpr std::size_t kStride = 162;
    RecordWriter record(out, 0x4221);
    record.u8(1).u16(hsdpa.subFrames | static_cast<unsigned>(hsdpa.carriers) << kCarriersShift);
    record.u8(static_cast<unsigned>(hsdpa.primary.size()));
    record.u8(static_cast<unsigned>(hsdpa.secondary.size()));
    putProcesses(record, hsdpa.primary);
    if (!hsdpa.secondary.empty()) {
        record.padTo(kProcessesStart + kStride * hsdpa.primary.size());
        putProcesses(record, hsdpa.secondary);
    }
}

} // namespace pallax::gsm
