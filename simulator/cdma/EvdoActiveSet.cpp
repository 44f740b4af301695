#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"
#include "simulator/cdma/PowerPart.h"

namespace pallax::cdma {

//   byte  width  0x12B6
//   15    8      number of pilots
//   25    96     each pilot: PN (16), part of the power in 512ths (16), 8 bytes more
void encode(const EvdoActiveSet& set, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 15;
    constexpr std::size_t kPilotsStart = 25;
    constexpr std::size_t kRestOfPilot = 8;
    RecordWriter record(out, 0x12B6);
    record.padTo(kCountOffset).u8(static_cast<unsigned>(set.pilots.size())).padTo(kPilotsStart);
    for (const Pilot& pilot : set.pilots) {
        record.u16(pilot.pn).u16(rawPart(pilot.part_db)).skip(kRestOfPilot);
    }
}

} // namespace pallax::cdma
