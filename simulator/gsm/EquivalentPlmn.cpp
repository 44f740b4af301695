#include "simulator/RecordWriter.h"
#include "simulator/gsm/NetworkRecords.h"
#include "simulator/gsm/PlmnDigits.h"

namespace pallax::gsm {

//   byte  width  0x7150
//   16    8      number of networks
//   17    48     the network: digits of country and network in turns
void encode(const EquivalentPlmn& plmn, ByteBuffer& out) {
    constexpr std::size_t kCountOffset = 16;
    RecordWriter record(out, 0x7150);
    record.padTo(kCountOffset).u8(1);
    for (const unsigned weight : {100U, 10U, 1U}) {
        record.u8(digit(plmn.country, weight)).u8(digit(plmn.network, weight));
    }
}

} // namespace pallax::gsm
