#include "storing/ServerAsk.h"

#include "console/Output.h"
#include "host/Complaint.h"
#include "query/QueryTable.h"
#include "querying/RowWriter.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <optional>
#include <unistd.h>
#include <utility>

namespace pallax {

namespace {

using TableRows = std::vector<std::vector<QueryValue>>;

class FetchedRows final : public Rows {
public:
    explicit FetchedRows(const TableRows& rows) : _rows(rows) {}

    bool next() override { return ++_next <= _rows.size(); }
    void give(std::size_t column, ColumnValue& value) const override {
        const QueryValue& cell = _rows[_next - 1][column];
        if (const auto* integer = std::get_if<std::int64_t>(&cell)) {
            value.integer(*integer);
        } else if (const auto* real = std::get_if<double>(&cell)) {
            value.real(*real);
        } else if (const auto* text = std::get_if<std::string>(&cell)) {
            value.text(*text);
        }
    }

private:
    const TableRows& _rows;
    std::size_t _next = 0;
};

/// A table that a server makes, when it is read first.
class FetchedTable final : public QueryTable {
public:
    FetchedTable(ServerTable table, ServerStore& store) : _table(std::move(table)), _store(store) {
        for (const std::string& name : _table.columns) {
            _columns.push_back({name, ""});
        }
    }

    const std::vector<Column>& columns() const override { return _columns; }
    std::unique_ptr<Rows> rows(const RowBounds& /*bounds*/) override {
        if (!_rows) {
            _rows = _store.server().rows(_table.query, _columns.size());
        }
        return std::make_unique<FetchedRows>(*_rows);
    }
    double expectedRows() const override {
        constexpr double kFew = 1000;
        return kFew;
    }

private:
    ServerTable _table;
    ServerStore& _store;
    std::vector<Column> _columns;
    std::optional<TableRows> _rows;
};

void addTable(Database& database, ServerStore& store, ServerTable table) {
    const std::string name = table.name;
    database.add("main", name, std::make_unique<FetchedTable>(std::move(table), store));
}

/// Whether the server could not answer, and the query may be right.
bool isTrouble(const ServerRefusal& refusal) {
    // ClickHouse's numbers of limits of rows, time and memory, of networks and of missing servers
    constexpr std::array kTroubles{158, 159, 160, 173, 202, 209, 210, 241, 243, 279, 307, 394};
    return std::find(kTroubles.begin(), kTroubles.end(), refusal.code) != kTroubles.end();
}

} // namespace

void addServerTables(Database& database, ServerStore& store, const StoreAskOptions& options) {
    addTable(database, store, {"field", {"name", "in_list"}, "SELECT name, in_list FROM field"});
    const bool isList =
        options.question == StoreQuestion::Devices || options.question == StoreQuestion::Recordings;
    if (isList) {
        addTable(database, store,
                 {"recordings",
                  {"device", "name", "technology", "decoder", "every", "identities", "packets",
                   "first", "last", "trouble"},
                  "SELECT device, name, technology, decoder, every, identities, packets, first, "
                  "last, trouble FROM recordings"});
    } else if (options.device) { // which is first, before those whose names may be suggested
        addTable(database, store,
                 {"recordings",
                  {"device", "first", "last"},
                  formatText("SELECT device, min(first), max(last) FROM recordings GROUP BY device "
                             "ORDER BY device = %@ DESC, device LIMIT 100000",
                             {clickHouseText(*options.device)})});
    } else if (options.from || options.to) {
        addTable(database, store,
                 {"recordings",
                  {"first", "last"},
                  "SELECT min(first), max(last) FROM recordings HAVING count() > 0"});
    }
}

std::string addServerQuestion(Database& database, ServerStore& store,
                              const StoreAskOptions& options,
                              const std::vector<JudgedLevel>& levels, const AskedTime& time) {
    ServerQuestion question = serverQuestion(options, levels, time, store);
    for (ServerTable& table : question.tables) {
        addTable(database, store, std::move(table));
    }
    return question.query;
}

Patience patienceOf(const StoreAskOptions& options) {
    Patience patience;
    if (options.timeout) {
        const auto whole = std::chrono::ceil<std::chrono::milliseconds>(*options.timeout);
        patience.whole = whole;
        patience.silence = std::max(patience.silence, whole);
    }
    return patience;
}

ExitStatus askServer(ServerStore& store, const StoreAskOptions& options) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    std::optional<RowWriter> writer;
    ExitStatus status = kExitSuccess;
    store.server().ask(
        options.words.at(0),
        [&](const std::vector<std::string>& names) {
            writer.emplace(options.format, names, output);
        },
        [&](std::vector<QueryValue> row) { writer->write(std::move(row)); },
        [&](const ServerRefusal& refusal) {
            complain(refusal.message + ".");
            status = isTrouble(refusal) ? kExitFailure : kExitWrongUsage;
        });
    if (writer) {
        writer->finish();
    }
    return status;
}

} // namespace pallax
