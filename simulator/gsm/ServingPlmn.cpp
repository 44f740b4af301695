#include "simulator/RecordWriter.h"
#include "simulator/gsm/NetworkRecords.h"
#include "simulator/gsm/PlmnDigits.h"

namespace pallax::gsm {

//   byte  width  0x7135, 32 bytes
//   13    8      network operating mode
//   14    8      service type
//   15    24     network: digits in pairs, the low half first; 15 for a missing one
//   18    16     location area, high byte first
//   20    8      routing area
void encode(const ServingPlmn& plmn, ByteBuffer& out) {
    constexpr std::size_t kLength = 32;
    constexpr unsigned kNoDigit = 15;
    constexpr unsigned kByte = 8;
    constexpr unsigned kNibble = 4;
    RecordWriter(out, 0x7135)
        .u8(plmn.operatingMode)
        .u8(plmn.serviceType)
        .u8(digit(plmn.country, 100) | digit(plmn.country, 10) << kNibble)
        .u8(digit(plmn.country, 1) | kNoDigit << kNibble)
        .u8(digit(plmn.network, 10) | digit(plmn.network, 1) << kNibble)
        .u8(plmn.locationArea >> kByte)
        .u8(plmn.locationArea)
        .u8(plmn.routingArea)
        .padTo(kLength);
}

} // namespace pallax::gsm
