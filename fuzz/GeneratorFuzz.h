#pragma once

#include "LogGenerator/Common/LogCode_0xFF000020.h"
#include "LogGenerator/LogGenerator.h"
#include "platform/SystemLog.h"
#include "tests/doubles/GeneratorFixture.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

namespace pallax {

/// Has the text of every log line made.
class Listener final : public LogSink {
public:
    Listener() { SystemLog::setSink(this); }
    ~Listener() override { SystemLog::setSink(nullptr); }
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;
    void write(LogPriority /*priority*/, std::string_view /*text*/) override {}
};

/// The next packet of `input`, which is moved behind it.
inline Bytes takePacket(Bytes& input) {
    constexpr std::size_t kLengthBytes = 2;
    const LogRecord head(input);
    const std::size_t start = std::min(kLengthBytes, input.size());
    const std::size_t length = std::min<std::size_t>(head.u16(0), input.size() - start);
    const Bytes packet = input.subspan(start, length);
    input = input.subspan(start + length);
    return packet;
}

/// The text of the display after the packets, which makes that of every value; a snapshot is made
/// of it too.
inline std::string displayAfter(Bytes input, LogGenerator& generator) {
    Dictionary state;
    while (!input.empty()) {
        const Bytes packet = takePacket(input);
        // A copy of its own, so that a sanitizer sees a read past the packet.
        const ByteBuffer message(packet.begin(), packet.end());
        try {
            generator.updateState(state, message);
        } catch (const LogCode_0xFF000020::UnknownDataException&) { // NOLINT: allowed, see below
        }
    }
    const PropertyList display = generator.generateLogUsingState(state);
    (void)generator.getSaveContentsFromState(state);
    return display.description();
}

/// A generator under any sequence of packets, up to the display and what a snapshot would save.
/// The input is packets behind each other, each behind its length (16 bits, little-endian; the
/// last one may be cut). Whether somebody reads the log, so that each record is read when it
/// arrives, or nobody, so that some are kept, the display must be the same.
///
/// The one exception that a record may throw is that of a SIM-file record whose property list
/// cannot be parsed. Everything else, an index past a record's own count above all, ends the run.
inline void fuzzGenerator(Bytes input, decltype(Technology::generator) makeGenerator,
                          const std::string& templateName, PropertyList displayTemplate) {
    doubles::GeneratorFixture fixture;
    fixture.resources.add(templateName, std::move(displayTemplate));
    const auto kept = displayAfter(input, *makeGenerator(fixture.environment()));
    const Listener listener;
    if (displayAfter(input, *makeGenerator(fixture.environment())) != kept) {
        std::abort();
    }
}

} // namespace pallax
