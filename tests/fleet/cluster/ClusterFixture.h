#pragma once

#include "tests/cli/EndToEnd.h"
#include "tests/fleet/cluster/PrivateServers.h"

#include <string>
#include <vector>

namespace pallax {

/// Runs the real program on private servers, beside a store in a file.
class ClusterFixture : public EndToEnd {
protected:
    static std::string sample(const std::string& name) {
        return std::string(PALLAX_SOURCE_DIR) + "/samples/" + name;
    }
    /// A simulated recording; rows of a few seconds take long enough to be broken off.
    std::string simulated(const std::string& name, int length, int seed) const {
        EXPECT_EQ(run({"simulate", "lte", "--seconds", std::to_string(length), "--seed",
                       std::to_string(seed), "-o", world.path(name)})
                      .status,
                  0);
        return world.path(name);
    }

    Run ask(const std::string& store, std::vector<std::string> words) const {
        std::vector<std::string> arguments{"store", "query", "--store", store, "--format", "csv"};
        arguments.insert(arguments.end(), words.begin(), words.end());
        return run(arguments);
    }
    /// The answer to a question, which must be one.
    std::string answer(const std::string& store, const std::vector<std::string>& words) const {
        const Run asked = ask(store, words);
        EXPECT_EQ(asked.status, 0) << store << " " << words.back() << "\n" << asked.err;
        return asked.out;
    }
    /// Queries on all that a store holds, in an order that both engines have.
    static std::vector<std::string> queries() {
        return {"select start, hold, field, coalesce(entry, '') as e, number, text, raw, reason, "
                "unit, coalesce(system, '') as s, coalesce(cell, '') as c, packet, device, "
                "recording, technology, decoder from measurement order by device, recording, "
                "field, e, start, packet, hold, s, c, text",
                "select start, packet, field, coalesce(entry, '') as e, hold, number, text, unit, "
                "device, recording from span order by device, recording, field, e, start, packet, "
                "hold, text",
                "select time, packet, kind, words, fields, device, recording from event order by "
                "device, recording, time, packet, kind, words, fields",
                "select role, system, identity, code, channel, first_time, last_time, packet, "
                "readings, measure, best_level, last_level, device, recording from cell order by "
                "device, recording, role, system, identity",
                "select name, path, kind, unit, least, most, in_list, identifies, personal, "
                "meaning, shown from field order by name",
                "select device, name, technology, decoder, every, identities, packets, first, "
                "last, trouble from recordings order by device, name"};
    }
    std::string content(const std::string& store) const {
        std::string all;
        for (const std::string& query : queries()) {
            all += answer(store, {"--sql", query});
        }
        return all;
    }
};

} // namespace pallax
