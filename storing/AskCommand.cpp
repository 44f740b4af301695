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
#include "querying/QueryRun.h"
#include "store/StoredSections.h"
#include "storing/Loading.h"
#include "storing/Questions.h"
#include "text/Format.h"
#include "text/Suggestion.h"
#include "timeline/FieldTable.h"

#include <algorithm>
#include <deque>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

using Question = StoreAskOptions::Question;

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
    Ask(const StoreAskOptions& options, const std::string& file, const QualityProfile& profile)
        : _options(options), _file(file), _database(file), _profile(profile) {
        addFunctions(_database, installedKnowledge());
        addTechnologies();
    }

    ExitStatus run() {
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
        return run.run(_options.question == Question::Section
                           ? sectionQuery(_options, _section, *time)
                           : queryOf(_options, _levels, *time),
                       _options.format);
    }

private:
    /// Why there are none; nothing if the question needs none.
    std::optional<std::string> findLevels() {
        if (_options.question == Question::Series) {
            return findField(_options.words.front());
        }
        if (_options.question == Question::Section) {
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
        section.table = table.schema + ".\"" + table.name + "\"";
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

    /// Of the technologies that the store has.
    void addTechnologies() {
        if (_options.question != Question::Sql && _options.question != Question::Section) {
            return;
        }
        std::vector<const FieldTable*> tables;
        for (const std::string& name :
             textsOf(_database, "SELECT DISTINCT technology FROM recordings ORDER BY 1")) {
            if (const RecordedTechnology* technology = technologyOfCommandName(name)) {
                tables.push_back(&_fields.emplace_back(*technology, _resources));
                addStoredSections(_database, _file, *tables.back());
            }
        }
        if (!tables.empty()) {
            addLabelFunction(_database, std::move(tables));
        }
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
    std::string _file;
    RequiredTemplates _resources{DirectoryResources::programFolder()};
    std::deque<FieldTable> _fields; // outlive the database
    Database _database;
    const QualityProfile& _profile;
    std::vector<JudgedLevel> _levels;
    AskedSection _section;
};

} // namespace

ExitStatus runStoreAsk(const StoreAskOptions& options) {
    const std::string file = storeFile(options.store);
    if (const auto refusal = StoreConnection::refusal(file)) {
        complain(*refusal);
        return kExitFailure;
    }
    const auto profile = profileOrComplaint({options.profile, true, "store"});
    if (!profile) {
        return profile.error();
    }
    return Ask(options, file, *profile).run();
}

} // namespace pallax
