#pragma once

#include "LogGenerator/LogPacket.h"
#include "LogGenerator/Records/LayoutRecord.h"
#include "tests/doubles/RecordBuilder.h"

#include <benchmark/benchmark.h>

namespace pallax {

using doubles::Record;

/// The cost of one packet for a record class with a section.
template <class RecordClass, Record (*makePacket)()>
void measure(benchmark::State& state) {
    ClassDict classDict;
    CodeDict codeDict;
    RecordClass record;
    record.initWithDict(classDict, codeDict);
    const bool list = record.sectionKind() == SectionKind::List;
    record.updateSectionRef(list ? PropertyList(Array()) : PropertyList(Dictionary()));
    const ByteBuffer bytes = makePacket().bytes();
    const LogRecord packet{Bytes(bytes)};
    const LogCode logCode = LogPacketGetLogCode(packet);
    for ([[maybe_unused]] const auto iteration : state) {
        record.updateWithData(packet, logCode);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations());
}

/// Only zeros after the header.
template <LogCode logCode, std::size_t length>
Record zeros() {
    return Record(logCode).padTo(length);
}

} // namespace pallax
