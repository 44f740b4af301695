// The whole GSM/UMTS generator under any sequence of packets, up to the display and what a
// snapshot would save. The input is packets behind each other, each behind its length (16 bits,
// little-endian; the last one may be cut).
//
// The one exception that a record may throw is that of a SIM-file record whose property list
// cannot be parsed. Everything else, an index past a record's own count above all, ends the run.

#include "LogGenerator/Records/Exceptions.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"
#include "platform/SystemLog.h"
#include "tests/doubles/GeneratorFixture.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>

using namespace pallax; // NOLINT: a program of its own

namespace {

/// Has the text of every log line made.
class Listener final : public LogSink {
public:
    Listener() { SystemLog::setSink(this); }
    ~Listener() override { SystemLog::setSink(nullptr); }
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;
    void write(LogPriority /*priority*/, std::string_view /*text*/) override {}
};

/// The sections of resources/ZOR_GSM.plist.
PropertyList displayTemplate() {
    return Dictionary{
        {"Serving PLMN", Dictionary()},
        {"Equivalent PLMN List", Array()},
        {"Process CO", Dictionary()},
        {"Process CS", Dictionary()},
        {"Process PS", Dictionary()},
        {"GSM Serving Cell", Dictionary()},
        {"GSM RR Info", Dictionary()},
        {"Neighboring Cells", Array()},
        {"Mobile Allocation", Dictionary()},
        {"GPRS Information", Dictionary()},
        {"Coding Scheme", Dictionary()},
        {"Cell Change Counters", Dictionary()},
        {"UMTS RR Info", Dictionary()},
        {"UMTS RR Measurement", Dictionary()},
        {"Active Set", Array()},
        {"Monitored Set", Array()},
        {"Detected Set", Array()},
        {"Virtual Active Set", Array()},
        {"UMTS Set", Array()},
        {"GSM Set", Array()},
        {"Non-Ranked UMTS Set", Array()},
        {"Non-Ranked GSM Set", Array()},
        {"BLER", Dictionary()},
        {"HSDPA Info", Dictionary()},
        {"PDP Context Info", Array()},
        {"SIM Info", Dictionary()},
    };
}

/// The next packet of `input`, which is moved behind it.
Bytes takePacket(Bytes& input) {
    constexpr std::size_t kLengthBytes = 2;
    const LogRecord head(input);
    const std::size_t start = std::min(kLengthBytes, input.size());
    const std::size_t length = std::min<std::size_t>(head.u16(0), input.size() - start);
    const Bytes packet = input.subspan(start, length);
    input = input.subspan(start + length);
    return packet;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const Listener listener;
    doubles::GeneratorFixture fixture;
    fixture.resources.add("ZOR_GSM", displayTemplate());
    const auto generator = ZOR_GSMLogGenerator::generator(fixture.environment());
    Dictionary state;
    for (Bytes input(data, size); !input.empty();) {
        const Bytes packet = takePacket(input);
        // A copy of its own, so that a sanitizer sees a read past the packet.
        const ByteBuffer message(packet.begin(), packet.end());
        try {
            generator->updateState(state, message);
        } catch (const LogCode_0xFF000020::UnknownDataException&) { // NOLINT: allowed, see above
        }
    }
    const PropertyList display = generator->generateLogUsingState(state);
    (void)display.description(); // makes the text of every value
    (void)generator->getSaveContentsFromState(state);
    return 0;
}
