// Nanoseconds that one packet costs each parser of CDMA, with one place for each lookup name.

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/EVDOActiveSet.h"
#include "LogGenerator/C2K/EVDOStatus.h"
#include "LogGenerator/C2K/FingerC2I.h"
#include "LogGenerator/C2K/ForwardDataRate.h"
#include "LogGenerator/C2K/OneXStatus.h"
#include "LogGenerator/C2K/OneXSystemIdentity.h"
#include "LogGenerator/C2K/OneXTrafficErrors.h"
#include "LogGenerator/C2K/ReverseDataRate.h"
#include "bench/MeasureRecord.h"
#include "tests/doubles/SubpacketBuilder.h"

#include <initializer_list>

namespace pallax {
namespace {

using doubles::packetOf;
using doubles::Subpacket;

Dictionary lookupTable() {
    Dictionary lookup;
    const auto display = std::make_shared<Dictionary>();
    for (const char* name : {"kChannel",
                             "kBandClass",
                             "kSystemId",
                             "kNetworkId",
                             "kBaseId",
                             "kPacketZoneId",
                             "kProtocolRevision",
                             "kServingPNOffset",
                             "k1xDeviceState",
                             "k1xEVDODeviceState",
                             "k1xRoamingHome",
                             "k1xRx0BandClass",
                             "k1xRx0ChanNum",
                             "k1xRx1BandClass",
                             "k1xRx1ChanNum",
                             "k1xRxAGC0",
                             "k1xRxAGC1",
                             "k1xTxAGC",
                             "k1xTrafficFER",
                             "k1xActiveSetInfo",
                             "kRxAGC0",
                             "kRxAGC1",
                             "kTxAGC",
                             "kFLDataRate",
                             "kRLDataRate",
                             "kActiveSetPilots",
                             "kFingerC2I",
                             "kColorCode",
                             "kSessionState",
                             "kUATI24"}) {
        addLookupPlace(name, name, display, lookup);
    }
    return lookup;
}

/// What one packet costs a parser; its running values go on from packet to packet. The sequence
/// numbers of the data rates stand still, so that these show nothing.
template <auto parse, Record (*makePacket)()>
void measureParser(benchmark::State& state) {
    const Dictionary lookup = lookupTable();
    Dictionary running{{"ExtraInfo", Dictionary()}};
    const ByteBuffer bytes = makePacket().bytes();
    const LogRecord packet{Bytes(bytes)};
    for ([[maybe_unused]] const auto iteration : state) {
        parse(packet, running, lookup);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations());
}

/// Connected, so that every level is shown.
Record connectedStatus() {
    return Record(0x1183).padTo(50).at(36, 5);
}

Record sixPilots() {
    return Record(0x12B6).padTo(25 + 6 * 12).at(15, 6);
}

Record sixFingers() {
    return Record(0x108A).padTo(23 + 6 * 14).at(22, 6);
}

/// In traffic with three pilots.
Record trafficStatus() {
    return packetOf(0x119C, {Subpacket(1).u8(8), Subpacket(2).padTo(14),
                             Subpacket(3).u16(64).u8(1).u8(2).u8(3).u8(1).padTo(72), Subpacket(4)});
}

Record trafficFrame() {
    return packetOf(0x119D, {Subpacket(11).padTo(28)});
}

Record identity() {
    return Record(0x134F).u8(2).padTo(190).at(46, 2);
}

// One line for each parser.
BENCHMARK_TEMPLATE(measureParser, parseFingerC2I, sixFingers);
BENCHMARK_TEMPLATE(measureParser, parseEVDOStatus, connectedStatus);
BENCHMARK_TEMPLATE(measureParser, parseForwardDataRate, zeros<0x1192, 241>);
BENCHMARK_TEMPLATE(measureParser, parseEVDOActiveSet, sixPilots);
BENCHMARK_TEMPLATE(measureParser, parseOneXStatus, trafficStatus);
BENCHMARK_TEMPLATE(measureParser, parseOneXTrafficErrors, trafficFrame);
BENCHMARK_TEMPLATE(measureParser, parseReverseDataRate, zeros<0x127E, 1750>);
BENCHMARK_TEMPLATE(measureParser, parseOneXSystemIdentity, identity);

} // namespace
} // namespace pallax
