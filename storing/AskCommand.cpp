#include "console/Output.h"
#include "decoding/DecodeWindow.h"
#include "decoding/InstalledKnowledge.h"
#include "decoding/RequiredTemplates.h"
#include "host/Complaint.h"
#include "host/DirectoryResources.h"
#include "host/MonotonicClock.h"
#include "host/WallClock.h"
#include "platform/RecordedTechnology.h"
#include "query/Functions.h"
#include "query/LabelFunction.h"
#include "query/QueryTable.h"
#include "query/SqlText.h"
#include "querying/QueryRun.h"
#include "store/StoreConnection.h"
#include "store/StoredSections.h"
#include "storing/Loading.h"
#include "storing/Questions.h"
#include "storing/ServerAsk.h"
#include "text/Format.h"
#include "text/Suggestion.h"
#include "timeline/FieldTable.h"

#include <algorithm>
#include <deque>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

/// The rows of a query that the program itself asks.
std::vector<std::vector<QueryValue>> rowsOf(Database& database, const std::string& query) {
    auto prepared = database.prepare(query);
    if (!prepared) {
        throw StoreFailure(prepared.error().sentence);
    }
    Query running = std::move(prepared).value();
    std::vector<std::vector<QueryValue>> rows;
    while (true) {
        auto row = running.next();
        if (!row) {
            throw StoreFailure(row.error().sentence);
        }
        if (!*row) {
            return rows;
        }
        rows.push_back(**row);
    }
}

/// The texts of the first column.
std::vector<std::string> textsOf(Database& database, const std::string& query) {
    std::vector<std::string> texts;
    for (const std::vector<QueryValue>& row : rowsOf(database, query)) {
        const auto* text = std::get_if<std::string>(&row.front());
        texts.push_back(text != nullptr ? *text : "");
    }
    return texts;
}

/// "No field of the store is named "rspr". Did you mean "rsrp"?"
std::string unknown(const std::string& sentence, const std::string& name,
                    const std::vector<std::string>& names) {
    const std::string meant = suggestion(name, names);
    return formatText(sentence, {name}) + (meant.empty() ? "." : meant);
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
        const auto time = findTime();
        if (!time) {
            complain(time.error());
            return kExitFailure;
        }
        Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
        const MonotonicClock clock;
        QueryRun run(_database, {_options.timeout},
                     {output, clock, [] {}, [](std::string_view sentence) { complain(sentence); }});
        return run.run(queryFor(*time, store), _options.format);
    }

private:
    std::string queryFor(const AskedTime& time, ServerStore* store) {
        if (_options.question == StoreQuestion::Section) {
            return sectionQuery(_options, _section, time);
        }
        return store != nullptr ? addServerQuestion(_database, *store, _options, _levels, time)
                                : queryOf(_options, _levels, time);
    }
    /// Why there are none; nothing if the question needs none.
    std::optional<std::string> findLevels() {
        if (_options.question == StoreQuestion::Series) {
            return findField(_options.words.front());
        }
        if (_options.question == StoreQuestion::Section) {
            return findSection(_options.words.front());
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
        return unknown("No field of the store is named \"%@\"", name, all);
    }
    std::optional<std::string> findSection(const std::string& name) {
        std::vector<std::string> found;
        std::vector<std::string> all;
        for (const Database::Table& table : _database.tables()) {
            const std::string full = table.schema + "." + table.name;
            all.insert(all.end(), {full, table.name});
            if (name == full || name == table.name) {
                found.push_back(full);
                _section = sectionOf(table);
            }
        }
        if (found.size() > 1) {
            return formatText("\"%@\" can be %@ or %@.", {name, found[0], found[1]});
        }
        return !found.empty()
                   ? std::nullopt
                   : std::optional(unknown("No section of the store is named \"%@\"", name, all));
    }
    static AskedSection sectionOf(const Database::Table& table) {
        AskedSection section;
        section.table = table.schema + "." + quotedName(table.name);
        for (const Column& column : table.columns) {
            section.isList = section.isList || (column.name == "entry" && !column.isHidden);
            if (column.role == Column::Role::Value) {
                section.fields.push_back(column.name);
            }
        }
        return section;
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
                             unknown("The store has no device \"%@\"", *_options.device, devices));
    }

    /// Of the recordings that the question is about.
    Result<AskedTime, std::string> findTime() {
        DecodeWindow window({_options.from, _options.to});
        if (window.isOpen()) {
            return AskedTime();
        }
        const auto rows =
            rowsOf(_database,
                   "SELECT min(first), max(last) FROM recordings" +
                       (_options.device ? " WHERE device = " + quotedText(*_options.device) : ""));
        const auto* first = std::get_if<std::int64_t>(&rows.front()[0]);
        const auto* last = std::get_if<std::int64_t>(&rows.front()[1]);
        if (first == nullptr || last == nullptr) {
            return AskedTime(); // nothing is there
        }
        using std::chrono::milliseconds;
        const TimeSpan span{Time(milliseconds(*first)), Time(milliseconds(*last))};
        const WallClock zone;
        if (const auto refusal =
                window.open(span, [&zone](Time time) { return zone.zone(time).offset; })) {
            return *refusal;
        }
        const auto inMilliseconds = [](Time time) {
            return std::chrono::floor<milliseconds>(time.time_since_epoch()).count();
        };
        AskedTime asked;
        if (_options.from) {
            asked.from = inMilliseconds(window.from());
        }
        if (_options.to) {
            asked.to = inMilliseconds(window.to());
        }
        return asked;
    }

    const StoreAskOptions& _options;
    Database& _database;
    const QualityProfile& _profile;
    std::vector<JudgedLevel> _levels;
    AskedSection _section;
};

/// What a file has beside its views: sections and labels, of the technologies that are in it.
class FileTechnologies {
public:
    void addTo(Database& database, const std::string& file) {
        std::vector<const FieldTable*> tables;
        for (const std::string& name :
             textsOf(database, "SELECT DISTINCT technology FROM recordings ORDER BY 1")) {
            if (const RecordedTechnology* technology = technologyOfCommandName(name)) {
                tables.push_back(&_fields.emplace_back(*technology, _resources));
                addStoredSections(database, file, *tables.back());
            }
        }
        if (!tables.empty()) {
            addLabelFunction(database, std::move(tables));
        }
    }

private:
    RequiredTemplates _resources{DirectoryResources::programFolder()};
    std::deque<FieldTable> _fields;
};

ExitStatus askFile(const StoreAskOptions& options, const QualityProfile& profile) {
    const std::string file = storeFile(options.store);
    if (const auto refusal = StoreConnection::refusal(file)) {
        complain(*refusal);
        return kExitFailure;
    }
    FileTechnologies technologies; // outlive the database
    Database database(file);
    if (options.question == StoreQuestion::Sql || options.question == StoreQuestion::Section) {
        technologies.addTo(database, file);
    }
    return Ask(options, database, profile).run(nullptr);
}

ExitStatus askAddress(const StoreAskOptions& options, const QualityProfile& profile) {
    if (options.question == StoreQuestion::Section) {
        complain("Only a file has sections: ask a server with --sql.");
        return kExitWrongUsage;
    }
    ServerStore store(parseStoreAddress(options.store), patienceOf(options));
    if (options.question == StoreQuestion::Sql) {
        return askServer(store, options);
    }
    Database database;
    addServerTables(database, store, options);
    return Ask(options, database, profile).run(&store);
}

} // namespace

ExitStatus runStoreAsk(const StoreAskOptions& options) {
    const auto profile = profileOrComplaint({options.profile, true, "store"});
    if (!profile) {
        return profile.error();
    }
    return isStoreAddress(options.store) ? askAddress(options, *profile)
                                         : askFile(options, *profile);
}

} // namespace pallax
