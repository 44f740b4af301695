#include "simulator/RecordWriter.h"
#include "simulator/cdma/CdmaRecords.h"
#include "simulator/cdma/PowerPart.h"

namespace pallax::cdma {

//   byte  width  0x108A
//   22    8      number of fingers
//   23    112    each finger: PN (16) or 0xFFFF, 4 bytes, part of the power in 512ths (16), 6
//                bytes more
void encode(const Fingers& fingers, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 22;
    constexpr std::size_t kBeforePart = 4;
    constexpr std::size_t kAfterPart = 6;
    constexpr unsigned kNotLocked = 0xFFFF;
    RecordWriter record(out, 0x108A);
    record.padTo(kCountOffset).u8(static_cast<unsigned>(fingers.locked.size()) + 1);
    for (const Pilot& finger : fingers.locked) {
        record.u16(finger.pn).skip(kBeforePart).u16(rawPart(finger.part_db)).skip(kAfterPart);
    }
    record.u16(kNotLocked).skip(kBeforePart + 2 + kAfterPart);
}

} // namespace pallax::cdma
