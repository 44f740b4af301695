// Framing alone, and the path of one packet through the GSM/UMTS generator: framing, the
// subscribers of its code, and one or several records, most of which only keep the packet until a
// display is needed.

#include "LogGenerator/LogPacket.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"
#include "tests/doubles/GeneratorFixture.h"
#include "tests/doubles/RecordBuilder.h"

#include <benchmark/benchmark.h>

namespace pallax {
namespace {

using doubles::Record;

void framing(benchmark::State& state) {
    const ByteBuffer message = Record(0x7131).padTo(16).prefixed();
    for (auto _ : state) {
        const LogRecord record(LogPacketStripPrefix(message));
        benchmark::DoNotOptimize(LogPacketGetLogCode(record));
    }
}
BENCHMARK(framing);

/// The argument is the log code. A display is generated from time to time, like ticks, to keep the
/// raw capture small.
void dispatch(benchmark::State& state) {
    constexpr int kPacketsPerTick = 100;
    doubles::GeneratorFixture fixture;
    fixture.resources.add("ZOR_GSM", Dictionary{{"Process CO", Dictionary()},
                                                {"Process CS", Dictionary()},
                                                {"Process PS", Dictionary()},
                                                {"Serving PLMN", Dictionary()}});
    const auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    const ByteBuffer message = Record(static_cast<LogCode>(state.range(0))).padTo(16).prefixed();
    Dictionary display;
    int packets = 0;
    for (auto _ : state) {
        generator->updateState(display, message);
        if (++packets % kPacketsPerTick == 0) {
            benchmark::DoNotOptimize(generator->generateLogUsingState(display));
        }
    }
}
BENCHMARK(dispatch)->ArgName("code")->Arg(0x1234)->Arg(0x7130)->Arg(0x7132);

} // namespace
} // namespace pallax
