#include "simulator/RecordWriter.h"
#include "simulator/gsm/UmtsRecords.h"

namespace pallax::gsm {

//   byte  width  0x4116
//   13    8      number of channels
//   14    16     window, blocks
//   16    72     each channel: identity (8), blocks received (32), in error (32)
void encode(const BlockErrors& errors, ByteBuffer& out) {
    RecordWriter record(out, 0x4116);
    record.u8(static_cast<unsigned>(errors.channels.size())).u16(errors.window);
    for (const ChannelBlocks& channel : errors.channels) {
        record.u8(channel.channel).u32(channel.received).u32(channel.inError);
    }
}

} // namespace pallax::gsm
