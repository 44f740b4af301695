#include "cli/StoreRequest.h"

#include "cli/OptionParts.h"
#include "text/Format.h"

#include <map>
#include <set>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

constexpr const char* kStoreFooter = R"(Examples:
  pallax store load --device car1 monday/*.pcapng
  pallax store load --into fleet.db --pseudonyms key recordings/*.pcapng.gz
  pallax store watch --into fleet.db arriving
  pallax store query cells --below -110
  pallax store query series measured_rsrp --device car1 --every 1h
  pallax store query cells --from 2026-11-20T14:00 --to 2026-11-20T15:30
  pallax store query compare 2026-11-20 2026-11-21
  pallax store query --sql "select * from event where kind = 'service-lost'"
  pallax store setup --into clickhouse://db1/fleet
  pallax store load --into clickhouse://db1/fleet monday/*.pcapng

A store is one file that holds the measurements of many recordings and devices:
every value for as long as it held, in which cell. --into and --store name it;
the usual one is measurements.db in $XDG_DATA_HOME/pallax.

For a fleet, a store is a database of ClickHouse, on one server or on the shards
of a cluster: clickhouse://HOST[:PORT]/DATABASE. It answers the same questions.
Port 8123 is usual and speaks HTTP; 8443 speaks HTTPS. User and password come
from PALLAX_CLICKHOUSE_USER and PALLAX_CLICKHOUSE_PASSWORD, or from ~/.netrc.
Loading needs all servers of the shard of the device, and a question needs one
of each shard; without them there is an error, never a part of an answer.

setup [CLUSTER [SERVERS]] makes the tables of such a store on the server of
--into, and is run once for each server. CLUSTER is the name of the cluster in
the servers' configuration. If its shards have replicas, SERVERS is a cluster
that has each server as a shard.

load reads recordings and tells what became of each. A recording is known by its
packets: loading it again changes nothing, wherever the file is. It is replaced
when a newer version of pallax reads it, when it is to be read otherwise, or
when it has grown. Each is stored whole or not at all, so load can be ended at
any time and run again. A damaged recording is loaded up to where it is whole.
Only files can be loaded.

The device of a recording is the name of its folder, unless --device names it.
Values are those that the display shows at its ticks, every two seconds, and a
level that was read more than 10 s ago is not known any more; --every packet
keeps each value that was read, as the table "span" of pallax sql has it, in
more than ten times the space. What identifies a person is left out, or replaced
by pseudonyms (--pseudonyms; see pallax mask --help): with the same key, the
same person is the same in all recordings.

watch loads the recordings in FOLDER and in the folders in it, and then each one
that appears there (.pcap and .pcapng, also .gz and .zst), when it is written or
moved, until Ctrl-C.

query answers one of these questions:

devices, recordings: what the store holds.

cells: the serving cells, the worst first: for how long the level was known, for
which share of that time it was below a border, since when, and the values that
were not exceeded for 5, 50 and 95 % of the time. The levels are those that the
status shows; --level takes a field, the end of its name, or a measure (rsrp).
The border is --below or, by default, where the profile's grade "fair" ends.
--from and --to limit what cells, series, section, compare and coverage look at,
with times as pallax decode takes them: "start" and "end" are those of what the
store has, of one device with --device. A value counts for the part of its time
that lies between them; a section has the rows that begin there.

series FIELD: the course of a field of numbers in steps (--every 1m), for each
device and list entry: least, mean and greatest value, and for which share of
the step it was known.

section NAME: what a section of the display showed (serving_cell_measurements),
or a list in it (neighbor_cells_list): a row for each time in which nothing of
it changed, with a column for each field.

compare A B: the levels of two devices, recordings or days (2026-11-20, in UTC),
and the events of each kind per hour.

coverage: for each device and level, for which share of the time it had each
grade of the profile.

--sql: a query on the views span, event, cell and field, which are those of
pallax-sql(7) with the columns device and recording, as are, in a file, the
tables of the sections; on measurement, which also tells the serving cell; or on
the tables of the file, which sqlite3 opens, too. Times of values are in whole
milliseconds. A server has the dialect of ClickHouse, and no sections.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: the store failed, or a recording was refused or is damaged
  2   wrong usage, or a wrong query)";

void addLoading(CLI::App& app, StoreRequest& request) {
    app.add_option("--device", request.loading.device,
                   "The device of the recordings; of a question, only this device")
        ->type_name("NAME");
    app.add_option("--pseudonyms", request.loading.keyFile,
                   "Store pseudonyms of what identifies a person")
        ->type_name("KEYFILE");
    constexpr unsigned kMostJobs = 1024;
    app.add_option_function<std::string>(
           "--jobs",
           [&request](const std::string& text) {
               request.jobs = numberOf("--jobs", text, 1U, kMostJobs);
           },
           "How many recordings to load at once (default: one per core)")
        ->type_name("N");
}

/// "30s", "1m", "6h", "1d".
std::chrono::nanoseconds stepOf(const std::string& text) {
    static const std::map<char, std::chrono::seconds> units{{'s', std::chrono::seconds(1)},
                                                            {'m', std::chrono::minutes(1)},
                                                            {'h', std::chrono::hours(1)},
                                                            {'d', std::chrono::days(1)}};
    const auto unit = units.find(text.empty() ? ' ' : text.back());
    if (unit == units.end()) {
        throw CLI::ValidationError("--every", "\"" + text +
                                                  "\" is not tick, packet or a time "
                                                  "(30s, 1m, 6h, 1d)");
    }
    constexpr int kMost = 1000;
    return unit->second * numberOf("--every", text.substr(0, text.size() - 1), 1, kMost);
}

/// --every tick|packet of a load, or a duration of a series.
void addEvery(CLI::App& app, StoreRequest& request) {
    const auto take = [&request](const std::string& text) {
        if (text == "tick" || text == "packet") {
            request.loading.resolution = text == "tick" ? Resolution::Tick : Resolution::Packet;
        } else {
            request.asking.every = stepOf(text);
            request.isStep = true;
        }
    };
    app.add_option_function<std::string>(
           "--every", take,
           "Load the values at display ticks (the default) or of each packet; of a series, the "
           "length of a step (default: 1m)")
        ->type_name("tick|packet|TIME");
}

void addAsking(CLI::App& app, StoreAskOptions& asking) {
    app.add_option("--level", asking.levels, "The levels of cells (default: those of the status)")
        ->type_name("FIELD");
    app.add_option("--below", asking.below, "The border of a bad level (default: of the profile)")
        ->type_name("NUMBER");
    addTime(app, "--from", asking.from, "Only values from this time on");
    addTime(app, "--to", asking.to, "Only values up to this time");
    app.add_option("--entry", asking.entry, "Only this list entry of a series or section")
        ->type_name("WORDS");
    app.add_option("--profile", asking.profile, "The profile that judges levels (default: android)")
        ->type_name("android|field|operator|NAME");
    addChoice<RowFormat>(
        app, "--format", asking.format,
        {{"table", RowFormat::Table}, {"csv", RowFormat::Csv}, {"json", RowFormat::Json}},
        "How to write the rows (default: table)");
    app.add_option_function<std::string>(
           "--timeout",
           [&asking](const std::string& text) {
               const auto seconds = parseSeconds(text);
               if (!seconds) {
                   throw CLI::ValidationError("--timeout", seconds.error());
               }
               asking.timeout = *seconds;
           },
           "Stop a question after this time")
        ->type_name("SECONDS");
}

/// The question of the first word, and how many words follow it.
const std::vector<std::pair<std::string, std::pair<StoreQuestion, std::size_t>>>& questions() {
    static const std::vector<std::pair<std::string, std::pair<StoreQuestion, std::size_t>>> all{
        {"devices", {StoreQuestion::Devices, 0}},  {"recordings", {StoreQuestion::Recordings, 0}},
        {"cells", {StoreQuestion::Cells, 0}},      {"series", {StoreQuestion::Series, 1}},
        {"section", {StoreQuestion::Section, 1}},  {"compare", {StoreQuestion::Compare, 2}},
        {"coverage", {StoreQuestion::Coverage, 0}}};
    return all;
}

/// Which actions and questions take an option that not all take.
struct OptionUse {
    const char* option;
    std::set<std::string_view> takers;
};
const std::vector<OptionUse>& optionUses() {
    static const std::set<std::string_view> loading{"load", "watch"};
    static const std::set<std::string_view> asking{"devices", "recordings", "cells",    "series",
                                                   "section", "compare",    "coverage", "--sql"};
    static const std::set<std::string_view> measuring{"cells", "series", "section", "compare",
                                                      "coverage"};
    static const std::set<std::string_view> judging{"cells", "compare", "coverage"};
    static const std::vector<OptionUse> all{{"--jobs", {"load"}},
                                            {"--pseudonyms", loading},
                                            {"--device",
                                             {"load", "watch", "devices", "recordings", "cells",
                                              "series", "section", "compare", "coverage"}},
                                            {"--every", {"load", "watch", "series"}},
                                            {"--from", measuring},
                                            {"--to", measuring},
                                            {"--level", judging},
                                            {"--profile", judging},
                                            {"--below", {"cells", "compare"}},
                                            {"--entry", {"series", "section"}},
                                            {"--format", asking},
                                            {"--timeout", asking},
                                            {"--sql", asking}};
    return all;
}

/// Why the options do not fit to an action or question; empty if they do.
std::string refusalOf(const StoreRequest& request, const std::string& taker) {
    for (const OptionUse& use : optionUses()) {
        if (request.app->count(use.option) > 0 && !use.takers.contains(taker)) {
            return formatText("%@ takes no %@", {taker, use.option});
        }
    }
    if (request.app->count("--every") > 0 && request.isStep != (taker == "series")) {
        return formatText(
            "%@: --every takes %@",
            {taker, taker == "series" ? "a time (30s, 1m, 6h, 1d)" : "tick or packet"});
    }
    return "";
}

ParsedOptions askOptions(const StoreRequest& request) {
    StoreAskOptions asking = request.asking;
    asking.device = request.loading.device;
    asking.store = request.loading.store;
    std::vector<std::string> words = request.words;
    if (request.sql) {
        if (const std::string refusal = refusalOf(request, "--sql"); !refusal.empty()) {
            return wrongUsage(refusal, "store");
        }
        if (words.size() != 1) {
            return wrongUsage("--sql takes one query", "store");
        }
        asking.words = words;
        return asking;
    }
    std::string names;
    for (const auto& [name, question] : questions()) {
        names += (names.empty() ? "" : "|") + name;
        if (words.empty() || words.front() != name) {
            continue;
        }
        words.erase(words.begin());
        if (words.size() != question.second) {
            return wrongUsage(
                formatText("%@ takes %@", {name, question.second == 0   ? "no words"
                                                 : question.second == 2 ? "two words"
                                                 : name == "series"     ? "a field"
                                                                        : "the name of a section"}),
                "store");
        }
        if (const std::string refusal = refusalOf(request, name); !refusal.empty()) {
            return wrongUsage(refusal, "store");
        }
        asking.question = question.first;
        asking.words = words;
        return asking;
    }
    return wrongUsage(words.empty()
                          ? "query takes a question (" + names + ") or --sql"
                          : std::string(unknownChoice("query", words.front(), names).what()),
                      "store");
}

ParsedOptions setupOptions(const StoreRequest& request) {
    const auto& words = request.words;
    if (const std::string refusal = refusalOf(request, "setup"); !refusal.empty()) {
        return wrongUsage(refusal, "store");
    }
    if (words.size() > 2) {
        return wrongUsage("setup takes one or two clusters", "store");
    }
    return StoreSetupOptions{request.loading.store,
                             {words.empty() ? "" : words[0], words.size() < 2 ? "" : words[1]}};
}

} // namespace

void addStore(CLI::App& app, StoreRequest& request) {
    request.app = &app;
    addChoice<StoreRequest::Action>(app, "ACTION", request.action,
                                    {{"load", StoreRequest::Action::Load},
                                     {"query", StoreRequest::Action::Query},
                                     {"watch", StoreRequest::Action::Watch},
                                     {"setup", StoreRequest::Action::Setup}},
                                    "What to do")
        ->required();
    app.add_option(
           "WORDS", request.words,
           "The recordings to load (pcap or pcapng), or a question: devices, recordings, "
           "cells, series FIELD, section NAME, compare A B, coverage or, with --sql, a query; or "
           "the folder to watch; or clusters to set up")
        ->type_name("");
    app.add_option("--into,--store", request.loading.store,
                   "The file or the address of the store (default: measurements.db in the folder "
                   "for data)")
        ->type_name("FILE|clickhouse://HOST/DATABASE");
    addLoading(app, request);
    addEvery(app, request);
    addAsking(app, request.asking);
    app.add_flag("--sql", request.sql, "The question is a query in SQL");
    app.footer(kStoreFooter);
}

ParsedOptions storeOptions(const StoreRequest& request) {
    if (request.action == StoreRequest::Action::Setup) {
        return setupOptions(request);
    }
    if (request.action == StoreRequest::Action::Query) {
        return askOptions(request);
    }
    const bool isWatch = request.action == StoreRequest::Action::Watch;
    if (const std::string refusal = refusalOf(request, isWatch ? "watch" : "load");
        !refusal.empty()) {
        return wrongUsage(refusal, "store");
    }
    if (!isWatch && request.words.empty()) {
        return wrongUsage("load takes recordings", "store");
    }
    if (request.loading.device && request.loading.device->empty()) {
        return wrongUsage("a device has a name", "store");
    }
    if (isWatch) {
        return request.words.size() == 1
                   ? ParsedOptions(StoreWatchOptions{request.loading, request.words.front()})
                   : wrongUsage("watch takes one folder", "store");
    }
    return StoreLoadOptions{request.loading, request.words, request.jobs};
}

} // namespace pallax
