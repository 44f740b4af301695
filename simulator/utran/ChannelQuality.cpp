#include "simulator/RecordWriter.h"
#include "simulator/utran/UtranRecords.h"

namespace pallax::utran {

//   byte       bit  width  0xD00C
//   14         6    6      number T of transport channels
//   15         4    4      number of composite channels
//   17         0    16     each transport channel: identity (8), block errors (8)
//   289 + 34T  0    64     each composite channel: identity (8), time slot (8), six ratios (8)
void encode(const ChannelQuality& quality, ByteBuffer& out) {
    constexpr std::size_t kTransportStart = 17;
    constexpr std::size_t kCompositeStart = 289;
    constexpr std::size_t kTransportRoom = 34;
    RecordWriter record(out, 0xD00C);
    record.u8(1).padTo(kTransportStart);
    record.bits(14, 6, 6, static_cast<unsigned>(quality.transport.size()));
    record.bits(15, 4, 4, static_cast<unsigned>(quality.composite.size()));
    for (const TransportChannel& channel : quality.transport) {
        record.u8(channel.id).u8(channel.blockErrors);
    }
    record.padTo(kCompositeStart + kTransportRoom * quality.transport.size());
    for (const CompositeChannel& channel : quality.composite) {
        record.u8(channel.id).u8(channel.timeSlot);
        for (const unsigned ratio : channel.ratios) {
            record.u8(ratio);
        }
    }
}

} // namespace pallax::utran
