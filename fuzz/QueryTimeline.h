#pragma once

#include "LogGenerator/Technologies/Technologies.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "packets/PacketJournal.h"
#include "platform/RecordedTechnology.h"
#include "query/Database.h"
#include "query/Functions.h"
#include "query/TimelineTables.h"
#include "simulator/Simulation.h"
#include "timeline/Timeline.h"

#include <chrono>
#include <utility>
#include <vector>

namespace pallax {

/// The tables of a simulated drive of three seconds.
class QueryTimeline {
public:
    QueryTimeline() : _timeline(_journal, {_technology, _resources, _bundle, technologies()}) {
        constexpr unsigned kSeed = 7;
        constexpr unsigned kPacketsPerSecond = 20;
        Simulation simulation({&_technology, kSeed, kPacketsPerSecond, std::chrono::seconds(3)});
        while (const auto packet = simulation.next()) {
            _journal.packets.emplace_back(packet->time,
                                          ByteBuffer(packet->data.begin(), packet->data.end()));
        }
        (void)_timeline.index();
        addTimelineTables(database, _timeline);
        addFunctions(
            database,
            {[] { return nullptr; }, [](std::string_view name) { return builtInProfile(name); }},
            &_timeline.fields());
    }

    Timeline& timeline() { return _timeline; }

    Database database;

private:
    struct Journal final : public PacketJournal {
        std::uint64_t first() const override { return 1; }
        std::unique_ptr<PacketReader> reader(std::uint64_t from) override {
            return std::make_unique<Reader>(packets, from);
        }
        std::vector<std::pair<Time, ByteBuffer>> packets;
    };
    class Reader final : public PacketReader {
    public:
        Reader(const std::vector<std::pair<Time, ByteBuffer>>& packets, std::uint64_t next)
            : _packets(packets), _next(next) {}
        std::optional<JournalPacket> next() override {
            if (_next > _packets.size()) {
                return std::nullopt;
            }
            const auto& [time, data] = _packets[_next - 1];
            return JournalPacket{_next++, time, data};
        }

    private:
        const std::vector<std::pair<Time, ByteBuffer>>& _packets;
        std::uint64_t _next;
    };

    const RecordedTechnology& _technology = *technologyOfCommandName("lte");
    DirectoryResources _resources{DirectoryResources::programFolder()};
    BuildBundle _bundle;
    Journal _journal;
    Timeline _timeline;
};

} // namespace pallax
