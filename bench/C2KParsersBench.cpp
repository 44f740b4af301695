// Nanoseconds that one packet of each log code of CDMA costs, with one place for each lookup name.

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/EVDOActiveSet.h"
#include "LogGenerator/C2K/EVDOStatus.h"
#include "LogGenerator/C2K/FingerC2I.h"
#include "LogGenerator/C2K/ForwardDataRate.h"
#include "LogGenerator/C2K/LookupDisplay.h"
#include "LogGenerator/C2K/OneXStatus.h"
#include "LogGenerator/C2K/OneXSystemIdentity.h"
#include "LogGenerator/C2K/OneXTrafficErrors.h"
#include "LogGenerator/C2K/ReverseDataRate.h"
#include "tests/doubles/C2KLookupNames.h"
#include "tests/doubles/RecordBuilder.h"
#include "tests/doubles/SubpacketBuilder.h"

#include <benchmark/benchmark.h>

#include <initializer_list>

namespace pallax {
namespace {

using doubles::packetOf;
using doubles::Record;
using doubles::Subpacket;

/// Only zeros after the header.
template <LogCode logCode, std::size_t length>
Record zeros() {
    return Record(logCode).padTo(length);
}

DictionaryRef lookupTable() {
    const auto lookup = std::make_shared<Dictionary>();
    const auto display = std::make_shared<Dictionary>();
    for (const std::string& name : doubles::kLookupNames) {
        addLookupPlace(name, name, display, *lookup);
    }
    return lookup;
}

/// What one packet costs; its running values go on from packet to packet. With a place of the
/// sequence number's lowest byte, that counts up, so that a data rate is shown each time.
template <auto code, Record (*makePacket)(), std::size_t sequenceAt = 0>
void measureCode(benchmark::State& state) {
    const CodeLayout* const codes[] = {code};
    LookupDisplay display(codes);
    const DictionaryRef lookup = lookupTable();
    Dictionary running{{"ExtraInfo", Dictionary()}};
    ByteBuffer bytes = makePacket().bytes();
    const LogRecord packet{Bytes(bytes)};
    for ([[maybe_unused]] const auto iteration : state) {
        if constexpr (sequenceAt != 0) {
            ++bytes[sequenceAt];
        }
        if (code->accepts(*code, packet)) {
            display.take(0, packet, lookup, running);
            display.bringUpToDate();
        }
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations());
}

/// Connected, so that every level is shown.
Record connectedStatus() {
    return Record(0x1183).padTo(50).at(36, 5);
}

/// A list of entries from byte `start`; all their bytes are 1, so that no energy is 0.
Record sixEntries(LogCode code, std::size_t countAt, std::size_t start, std::size_t entrySize) {
    Record record(code);
    record.padTo(start + 6 * entrySize).at(countAt, 6);
    for (std::size_t offset = start; offset < start + 6 * entrySize; ++offset) {
        record.at(offset, 1);
    }
    return record;
}

Record sixPilots() {
    return sixEntries(0x12B6, 15, 25, 12);
}

Record sixFingers() {
    return sixEntries(0x108A, 22, 23, 14);
}

/// In traffic with three pilots.
Record trafficStatus() {
    Subpacket pilots = Subpacket(3).u16(64).u8(1).u8(2).u8(3).u8(1).padTo(72);
    for (const std::size_t energy : {28, 48, 68}) {
        pilots.putU16(energy, 900);
    }
    return packetOf(0x119C, {Subpacket(1).u8(8), Subpacket(2).padTo(14), pilots, Subpacket(4)});
}

Record trafficFrame() {
    return packetOf(0x119D, {Subpacket(11).padTo(28)});
}

Record identity() {
    return Record(0x134F).u8(2).padTo(190).at(46, 2);
}

// One line for each log code.
BENCHMARK_TEMPLATE(measureCode, &kFingerC2I, sixFingers);
BENCHMARK_TEMPLATE(measureCode, &kEVDOStatus, connectedStatus);
BENCHMARK_TEMPLATE(measureCode, &kForwardDataRate, zeros<0x1192, 241>, 13);
BENCHMARK_TEMPLATE(measureCode, &kEVDOActiveSet, sixPilots);
BENCHMARK_TEMPLATE(measureCode, &kOneXStatus, trafficStatus);
BENCHMARK_TEMPLATE(measureCode, &kOneXTrafficErrors, trafficFrame);
BENCHMARK_TEMPLATE(measureCode, &kReverseDataRate, zeros<0x127E, 1750>, 14);
BENCHMARK_TEMPLATE(measureCode, &kOneXSystemIdentity, identity);

} // namespace
} // namespace pallax
