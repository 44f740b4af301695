#pragma once

#include "host/RecordingWriter.h"
#include "query/Functions.h"
#include "store/FileStore.h"
#include "store/RecordingLoad.h"
#include "tests/doubles/Files.h"
#include "tests/query/QueryFixture.h"

#include <string>
#include <vector>

namespace pallax {

/// A simulated drive as a recording in a file, and a store.
class StoreFixture : public testing::Test, public TimelineFixture {
protected:
    explicit StoreFixture(std::string_view technologyName = "lte")
        : TimelineFixture(technologyName) {}

    /// Writes the first packets of the journal; all by default.
    std::string write(const std::string& name, std::uint64_t packets = UINT64_MAX) const {
        const std::string path = folder.path(name);
        const auto writer = RecordingWriter::create(path, technology.linkType);
        EXPECT_TRUE(writer) << path;
        for (std::uint64_t number = 1; number <= std::min(packets, journal.size()); ++number) {
            const JournalPacket packet = journal.packet(number);
            EXPECT_EQ((*writer)->write(packet.time, packet.data), std::nullopt);
        }
        return path;
    }

    LoadRequest request() const {
        LoadRequest made;
        made.device = "car1";
        made.maskOf = [](const RecordedTechnology& /*technology*/) {
            return [](ByteBuffer& /*packet*/) {};
        };
        made.identities = "left out";
        made.progress = [](const Recording& /*recording*/, std::uint64_t /*packets*/) {};
        return made;
    }
    LoadOutcome load(const std::string& path, const LoadRequest& wanted) {
        FileStore store(file);
        return loadRecording(path, wanted, {resources, bundle, technologies()}, store);
    }
    LoadOutcome load(const std::string& path) { return load(path, request()); }

    std::vector<std::string> ask(const std::string& query) const {
        Database database(file);
        addFunctions(database, {});
        return linesOf(database, query);
    }
    /// Everything that the store holds, without the numbers of rows.
    std::vector<std::string> content() const {
        std::vector<std::string> all;
        for (const char* query :
             {"SELECT device, name, digest, technology, decoder, every, identities, packets, "
              "first, last, trouble FROM recordings ORDER BY digest",
              "SELECT * FROM measurement ORDER BY recording, field, entry, start, packet, hold, "
              "text",
              "SELECT f.name, p.identity, r.digest, t.number, t.hold, t.first FROM totals t JOIN "
              "fields f ON f.id = t.field JOIN recordings r ON r.id = t.recording LEFT JOIN sites "
              "p ON p.id = t.site ORDER BY 1, 2, 3, 4",
              "SELECT * FROM event ORDER BY recording, time, kind, words",
              "SELECT * FROM cell ORDER BY recording, role, system, identity",
              "SELECT * FROM field ORDER BY name"}) {
            for (std::string& line : ask(query)) {
                all.push_back(std::move(line));
            }
        }
        return all;
    }

    doubles::TemporaryFolder folder;
    std::string file = folder.path("store.db");
};

} // namespace pallax
