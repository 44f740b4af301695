// Queries over a recording. Usage: query_bench RECORDING
//
// Prints one line for each figure, "NAME SECONDS" (processor time): a count, a sum and a maximum
// over all samples as the tables of a timeline give them ("samples"), and over an ordinary table
// with the same rows ("table"); 1,000 buckets of the first field ("series"); up to 1,000 events
// with the state of the tick after each ("events", and "joined", how many there were).

#include "LogGenerator/Technologies/Technologies.h"
#include "bench/ProcessorTime.h"
#include "host/BuildBundle.h"
#include "host/DirectoryResources.h"
#include "host/RecordingJournal.h"
#include "query/Database.h"
#include "query/TimelineTables.h"
#include "timeline/Timeline.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <sqlite3.h>
#include <string>
#include <variant>
#include <vector>

namespace {

using namespace pallax;

constexpr const char* kAggregate = "select count(*), sum(number), max(time) from sample";
constexpr const char* kSeries =
    "select count(*), sum(max - min) from series((select field from sample limit 1), 1000)";
constexpr const char* kEvents =
    "select e.time, e.words, s.* from (select * from event limit 1000) e "
    "join state s on s.time >= e.time and s.time < e.time + 2000000";

[[noreturn]] void fail(const std::string& sentence) {
    (void)std::fprintf(stderr, "query_bench: %s\n", sentence.c_str());
    std::exit(1); // NOLINT(concurrency-mt-unsafe)
}

/// Runs the query and returns the number of its rows.
template <class Take>
std::uint64_t run(Database& database, const char* text, const Take& take) {
    auto prepared = database.prepare(text);
    if (!prepared) {
        fail(prepared.error().sentence);
    }
    auto query = std::move(prepared).value();
    for (std::uint64_t rows = 0;; ++rows) {
        auto row = query.next();
        if (!row) {
            fail(row.error().sentence);
        }
        if (!*row) {
            return rows;
        }
        take(**row);
    }
}

void bindTo(sqlite3_stmt* insert, int place, const QueryValue& value) {
    if (const auto* number = std::get_if<std::int64_t>(&value)) {
        sqlite3_bind_int64(insert, place, *number);
    } else if (const auto* real = std::get_if<double>(&value)) {
        sqlite3_bind_double(insert, place, *real);
    } else if (const auto* text = std::get_if<std::string>(&value)) {
        sqlite3_bind_text(insert, place, text->data(), static_cast<int>(text->size()),
                          SQLITE_TRANSIENT);
    } else {
        sqlite3_bind_null(insert, place);
    }
}

/// The seconds of the same query over an ordinary table, and its first value.
double secondsOfTable(Database& database, std::int64_t& count) {
    sqlite3* plain = nullptr;
    sqlite3_stmt* insert = nullptr;
    if (sqlite3_open("", &plain) != SQLITE_OK ||
        sqlite3_exec(
            plain,
            "create table sample(time, packet, field, entry, raw, number, text, unit); begin",
            nullptr, nullptr, nullptr) != SQLITE_OK ||
        sqlite3_prepare_v2(plain, "insert into sample values (?, ?, ?, ?, ?, ?, ?, ?)", -1, &insert,
                           nullptr) != SQLITE_OK) {
        fail(sqlite3_errmsg(plain));
    }
    run(database, "select * from sample", [&](const std::vector<QueryValue>& row) {
        for (std::size_t column = 0; column < row.size(); ++column) {
            bindTo(insert, static_cast<int>(column) + 1, row[column]);
        }
        if (sqlite3_step(insert) != SQLITE_DONE || sqlite3_reset(insert) != SQLITE_OK) {
            fail(sqlite3_errmsg(plain));
        }
    });
    sqlite3_finalize(insert);
    sqlite3_stmt* select = nullptr;
    const double start = processorSeconds();
    if (sqlite3_prepare_v2(plain, kAggregate, -1, &select, nullptr) != SQLITE_OK ||
        sqlite3_step(select) != SQLITE_ROW) {
        fail(sqlite3_errmsg(plain));
    }
    const double seconds = processorSeconds() - start;
    count = sqlite3_column_int64(select, 0);
    sqlite3_finalize(select);
    sqlite3_close(plain);
    return seconds;
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        (void)std::fprintf(stderr, "usage: %s RECORDING\n", argv[0]);
        return 2;
    }
    auto journal = RecordingJournal::open(argv[1]);
    if (!journal) {
        fail(journal.error().sentence);
    }
    const DirectoryResources resources(DirectoryResources::programFolder());
    const BuildBundle bundle;
    Timeline timeline(**journal, {*(*journal)->technology(), resources, bundle, technologies()});
    (void)timeline.index();
    Database database;
    addTimelineTables(database, timeline);

    std::int64_t samples = 0;
    double start = processorSeconds();
    run(database, kAggregate,
        [&](const std::vector<QueryValue>& row) { samples = std::get<std::int64_t>(row[0]); });
    (void)std::printf("samples %.5f\n", processorSeconds() - start);
    start = processorSeconds();
    run(database, kSeries, [](const std::vector<QueryValue>& /*row*/) {});
    (void)std::printf("series %.5f\n", processorSeconds() - start);
    start = processorSeconds();
    const std::uint64_t joined =
        run(database, kEvents, [](const std::vector<QueryValue>& /*row*/) {});
    (void)std::printf("events %.5f\njoined %llu\n", processorSeconds() - start,
                      static_cast<unsigned long long>(joined));
    std::int64_t count = 0;
    (void)std::printf("table %.5f\n", secondsOfTable(database, count));
    if (count != samples) {
        fail("the ordinary table has another number of rows");
    }
    return 0;
}
