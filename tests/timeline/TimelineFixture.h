#pragma once

#include "LogGenerator/Technologies/Technologies.h"
#include "fields/Reference.h"
#include "host/DirectoryResources.h"
#include "packets/PacketJournal.h"
#include "platform/RecordedTechnology.h"
#include "simulator/Simulation.h"
#include "tests/doubles/FakeBundle.h"
#include "tests/doubles/Property.h"
#include "tests/doubles/RecordBuilder.h"
#include "timeline/Timeline.h"

#include <gtest/gtest.h>

#include <chrono>
#include <memory>
#include <string_view>
#include <utility>
#include <vector>

namespace pallax {

/// Packets in memory.
class MemoryJournal final : public PacketJournal {
public:
    void add(Time time, ByteBuffer data) { _packets.emplace_back(time, std::move(data)); }
    /// Drops the packets before this number.
    void dropBefore(std::uint64_t number) { _first = number; }
    std::uint64_t size() const { return _packets.size(); }
    /// How many packets its readers have given so far.
    std::uint64_t given() const { return _given; }
    JournalPacket packet(std::uint64_t number) const {
        const auto& [time, data] = _packets[number - 1];
        return {number, time, data};
    }

    std::uint64_t first() const override { return _first; }
    std::unique_ptr<PacketReader> reader(std::uint64_t from) override {
        return std::make_unique<Reader>(*this, std::max(from, _first));
    }

private:
    class Reader final : public PacketReader {
    public:
        Reader(MemoryJournal& journal, std::uint64_t next) : _journal(journal), _next(next) {}
        std::optional<JournalPacket> next() override {
            if (_next > _journal.size()) {
                return std::nullopt;
            }
            ++_journal._given;
            return _journal.packet(_next++);
        }

    private:
        MemoryJournal& _journal;
        std::uint64_t _next;
    };

    std::vector<std::pair<Time, ByteBuffer>> _packets;
    std::uint64_t _first = 1;
    std::uint64_t _given = 0;
};

/// A journal and what decodes it.
class TimelineFixture {
public:
    explicit TimelineFixture(std::string_view technologyName)
        : technology(*technologyOfCommandName(technologyName)) {}

    /// Adds the packets of a simulated drive.
    void drive(std::uint64_t seed, std::chrono::seconds duration, unsigned packetsPerSecond = 40) {
        Simulation simulation({&technology, seed, packetsPerSecond, duration});
        while (const auto packet = simulation.next()) {
            journal.add(packet->time, ByteBuffer(packet->data.begin(), packet->data.end()));
        }
    }
    /// Adds packets of any bytes in valid frames, of the codes that the technology reads; of an
    /// object stream, those of a drive. Such a record may throw.
    void anyPackets(std::size_t count) {
        namespace any = doubles::any;
        const auto codes = codesOf(gatherReference(technology, resources));
        if (codes.empty()) {
            return drive(any::bits(), std::chrono::seconds(2));
        }
        Time time = Simulation::kStart;
        for (std::size_t index = 0; index < count; ++index) {
            doubles::Record record(any::elementOf(codes));
            record.append(any::bytesBelow(256, static_cast<std::size_t>(any::between(0, 90))));
            time += std::chrono::milliseconds(any::between(0, 1500));
            journal.add(time, record.bytes());
        }
    }

    DecodingSource source() const { return {technology, resources, bundle, technologies()}; }
    /// With key frames so close that even short recordings have some.
    static Timeline::Limits closeKeyFrames(std::uint64_t distance = 50) {
        Timeline::Limits limits;
        limits.keyFrames.distance = distance;
        return limits;
    }
    std::unique_ptr<Timeline> indexed(const Timeline::Limits& limits = closeKeyFrames()) {
        auto timeline = std::make_unique<Timeline>(journal, source(), limits);
        EXPECT_TRUE(timeline->index());
        return timeline;
    }

    const RecordedTechnology& technology;
    DirectoryResources resources{PALLAX_SOURCE_DIR "/resources"};
    doubles::FakeBundle bundle;
    MemoryJournal journal;
};

inline const std::vector<const char*>& technologyNames() {
    static const std::vector<const char*> names{"ifx", "gsm", "cdma", "lte", "utran"};
    return names;
}

} // namespace pallax
