#include "simulator/RecordWriter.h"
#include "simulator/utran/UtranRecords.h"

namespace pallax::utran {

//   byte  width  0xD0E0
//   13    8      version
//   14    8      mode
void encode(RrcMode mode, ByteBuffer& out) {
    constexpr unsigned kVersion = 1; // the only known version
    RecordWriter(out, 0xD0E0).u8(kVersion).u8(static_cast<unsigned>(mode));
}

} // namespace pallax::utran
