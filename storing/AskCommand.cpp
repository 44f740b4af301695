#include "console/Output.h"
#include "decoding/InstalledKnowledge.h"
#include "host/Complaint.h"
#include "host/KnowledgeFiles.h"
#include "host/MonotonicClock.h"
#include "query/Functions.h"
#include "querying/QueryRun.h"
#include "store/StoreConnection.h"
#include "storing/Loading.h"
#include "storing/Questions.h"
#include "storing/ServerAsk.h"
#include "text/Format.h"
#include "text/Suggestion.h"

#include <algorithm>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

using Question = StoreAskOptions::Question;

/// The texts of the first column of a query that the program itself asks.
std::vector<std::string> textsOf(Database& database, const std::string& query) {
    auto prepared = database.prepare(query);
    if (!prepared) {
        throw StoreFailure(prepared.error().sentence);
    }
    Query running = std::move(prepared).value();
    std::vector<std::string> texts;
    while (true) {
        auto row = running.next();
        if (!row) {
            throw StoreFailure(row.error().sentence);
        }
        if (!*row) {
            return texts;
        }
        const auto* text = std::get_if<std::string>(&(**row).front());
        texts.push_back(text != nullptr ? *text : "");
    }
}

/// The end of a sentence about an unknown name.
std::string endOf(const std::string& name, const std::vector<std::string>& names) {
    const std::string meant = suggestion(name, names);
    return meant.empty() ? "." : meant;
}

class Ask {
public:
    Ask(const StoreAskOptions& options, Database& database, const QualityProfile& profile)
        : _options(options), _database(database), _profile(profile) {
        addFunctions(_database, installedKnowledge());
    }

    /// `store` has the intervals, if they are not in the database.
    ExitStatus run(ServerStore* store) {
        if (const auto refusal = findLevels()) {
            complain(*refusal);
            return kExitWrongUsage;
        }
        if (const auto refusal = unknownDevice()) {
            complain(*refusal);
            return kExitFailure;
        }
        Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
        const MonotonicClock clock;
        QueryRun run(_database, {_options.timeout},
                     {output, clock, [] {}, [](std::string_view sentence) { complain(sentence); }});
        return run.run(store != nullptr ? addServerQuestion(_database, *store, _options, _levels)
                                        : queryOf(_options, _levels),
                       _options.format);
    }

private:
    /// Why there are none; nothing if the question needs none.
    std::optional<std::string> findLevels() {
        if (_options.question == Question::Series) {
            return findField(_options.words.front());
        }
        _levels = judgedLevels(_options.levels, _options.below, _profile);
        return _levels.empty()
                   ? std::optional(formatText("\"%@\" is no level (see pallax store --help).",
                                              {_options.levels}))
                   : std::nullopt;
    }
    std::optional<std::string> findField(const std::string& name) {
        const std::string end = quotedText("." + name);
        const auto named = [&](const std::string& condition) {
            return textsOf(_database, "SELECT name FROM field WHERE (name = " + quotedText(name) +
                                          " OR substr(name, -length(" + end + ")) = " + end + ")" +
                                          condition);
        };
        auto found = named(" AND NOT in_list"); // is meant before those in lists
        if (found.size() != 1) {
            found = named("");
        }
        if (found.size() == 1) {
            _levels.push_back({found.front(), {found.front()}, {}, {}});
            return std::nullopt;
        }
        if (!found.empty()) {
            return formatText("\"%@\" can be %@ or %@.", {name, found[0], found[1]});
        }
        const auto all = textsOf(_database, "SELECT name FROM field");
        return formatText("No field of the store is named \"%@\"%@", {name, endOf(name, all)});
    }
    std::optional<std::string> unknownDevice() {
        if (!_options.device) {
            return std::nullopt;
        }
        const auto devices = textsOf(_database, "SELECT DISTINCT device FROM recordings");
        const bool isKnown =
            std::find(devices.begin(), devices.end(), *_options.device) != devices.end();
        return isKnown ? std::nullopt
                       : std::optional(
                             formatText("The store has no device \"%@\"%@",
                                        {*_options.device, endOf(*_options.device, devices)}));
    }

    const StoreAskOptions& _options;
    Database& _database;
    const QualityProfile& _profile;
    std::vector<JudgedLevel> _levels;
};

ExitStatus askFile(const StoreAskOptions& options, const QualityProfile& profile) {
    const std::string file = storeFile(options.store);
    if (const auto refusal = StoreConnection::refusal(file)) {
        complain(*refusal);
        return kExitFailure;
    }
    Database database(file);
    return Ask(options, database, profile).run(nullptr);
}

ExitStatus askAddress(const StoreAskOptions& options, const QualityProfile& profile) {
    ServerStore store(parseStoreAddress(options.store), patienceOf(options));
    if (options.question == Question::Sql) {
        return askServer(store, options);
    }
    Database database;
    addServerTables(database, store, options);
    return Ask(options, database, profile).run(&store);
}

} // namespace

ExitStatus runStoreAsk(const StoreAskOptions& options) {
    const auto profile = loadProfile(options.profile, profileFolder());
    if (!profile) {
        complain(profile.error().sentence +
                 (profile.error().isUnknown ? " (see pallax store --help)" : ""));
        return profile.error().isUnknown ? kExitWrongUsage : kExitFailure;
    }
    return isStoreAddress(options.store) ? askAddress(options, *profile)
                                         : askFile(options, *profile);
}

} // namespace pallax
