#pragma once

#include "LogGenerator/Common/LogCode_0xFF000020.h"
#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/Records/ClassIndex.h"
#include "platform/SystemLog.h"
#include "tests/doubles/GeneratorFixture.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

namespace pallax {

/// A template with the section of each record of a class index.
template <class Index>
PropertyList sectionsOf() {
    doubles::FakeStandardOutput output;
    const Index index(output);
    Dictionary sections;
    for (const ClassIndex::Numbered& each : index.records()) {
        const bool isList = each.record->sectionKind() == SectionKind::List;
        sections.setFixed(each.record->getSectionName(),
                          isList ? PropertyList(Array()) : PropertyList(Dictionary()));
    }
    return sections;
}

/// Formats the text of every log line.
class Listener final : public LogSink {
public:
    Listener() { SystemLog::setSink(this); }
    ~Listener() override { SystemLog::setSink(nullptr); }
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;
    void write(LogPriority /*priority*/, std::string_view /*text*/) override {}
};

/// The next packet of `input`, which is advanced past it.
inline Bytes takePacket(Bytes& input) {
    constexpr std::size_t kLengthBytes = 2;
    const LogRecord head(input);
    const std::size_t start = std::min(kLengthBytes, input.size());
    const std::size_t length = std::min<std::size_t>(head.u16(0), input.size() - start);
    const Bytes packet = input.subspan(start, length);
    input = input.subspan(start + length);
    return packet;
}

/// The text of the display after the packets, which formats every value; also makes a snapshot.
inline std::string displayAfter(Bytes input, LogGenerator& generator) {
    Dictionary state;
    while (!input.empty()) {
        const Bytes packet = takePacket(input);
        // A separate copy, so that a sanitizer detects reads past the packet.
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

/// A generator with any sequence of packets, up to the display and the contents of a snapshot. The
/// input is a sequence of packets, each after its length (16 bits, little-endian; the last one may
/// be cut). The display must be the same with a log sink, when each log record is read on arrival,
/// and without, when some are kept.
///
/// A record may only throw the exception of a SIM-file record whose property list cannot be parsed.
/// Any other exception, above all an index past a log record's own count, aborts.
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
