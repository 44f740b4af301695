#include "fleet/StoreSetup.h"

#include "store/MeasurementStore.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <optional>

namespace pallax {

namespace {

constexpr std::string_view kTable = "CREATE TABLE IF NOT EXISTS ";
constexpr std::string_view kView = "CREATE VIEW IF NOT EXISTS ";

void replace(std::string& text, std::string_view words, const std::string& by) {
    const std::size_t at = text.find(words);
    if (at != std::string::npos) {
        text.replace(at, words.size(), by);
    }
}

/// The name after the first words of a statement.
std::optional<std::string> nameAfter(const std::string& statement, std::string_view words) {
    if (!statement.starts_with(words)) {
        return std::nullopt;
    }
    return statement.substr(words.size(),
                            statement.find_first_of(" (", words.size()) - words.size());
}

std::string withoutComments(std::string_view text) {
    std::string plain;
    while (!text.empty()) {
        const std::size_t end = std::min(text.find('\n'), text.size() - 1) + 1;
        const std::string_view line = text.substr(0, end);
        const std::size_t comment = line.find("--");
        plain += line.substr(0, comment);
        plain += comment != std::string_view::npos ? "\n" : "";
        text.remove_prefix(end);
    }
    return plain;
}

std::vector<std::string> statementsOf(std::string_view text) {
    std::vector<std::string> statements;
    const std::string plain = withoutComments(text);
    for (std::size_t at = 0; at < plain.size();) {
        const std::size_t end = std::min(plain.find(';', at), plain.size());
        const std::size_t start = plain.find_first_not_of(" \n", at);
        if (start < end) {
            statements.push_back(plain.substr(start, end - start));
        }
        at = end + 1;
    }
    return statements;
}

/// A table over the table or view `name`_local of all shards.
std::string distributed(const std::string& name, const std::string& local,
                        const std::string& cluster, const std::string& database) {
    return formatText("%@%@ AS %@ ENGINE = Distributed(%@, %@, %@, cityHash64(%@))",
                      {kTable, name, local, cluster, database, local,
                       name == "fields" || name == "field" ? "name" : "device"});
}

class Setup {
public:
    Setup(const StoreLayout& layout, const std::string& database)
        : _layout(layout), _database(database) {}

    std::vector<std::string> statements() const {
        std::vector<std::string> all;
        for (std::string& statement : statementsOf(storeSetupText())) {
            if (nameAfter(statement, kView) == "store") {
                addEverywhere(all);
            }
            all.push_back(adapted(std::move(statement)));
        }
        return all;
    }

private:
    std::string adapted(std::string statement) const {
        const auto view = nameAfter(statement, kView);
        if (_layout.cluster.empty()) {
            return statement;
        }
        if (view == "store") {
            replace(statement, "'' AS cluster", clickHouseText(_layout.cluster) + " AS cluster");
            if (!_layout.servers.empty()) {
                replace(statement, "toUInt32(1) AS copies",
                        "max(replica_num) AS copies FROM system.clusters WHERE cluster = " +
                            clickHouseText(_layout.cluster));
            }
            return statement;
        }
        if (view && statement.ends_with(" AS SELECT * FROM " + *view + "_local")) {
            return distributed(*view, *view + "_local", _layout.cluster, _database);
        }
        const auto table = nameAfter(statement, kTable);
        if (table && !_layout.servers.empty()) {
            for (const std::string engine : {"AggregatingMergeTree()", "MergeTree()"}) {
                replace(statement, " " + engine,
                        formatText(" Replicated%@'/clickhouse/tables/{shard}/%@/%@', '{replica}')",
                                   {engine.substr(0, engine.size() - 1), _database, *table}));
            }
        }
        return statement;
    }
    /// Tables that see the rows of all copies.
    void addEverywhere(std::vector<std::string>& all) const {
        for (const std::string name : {"intervals", "events", "cells"}) {
            if (!_layout.servers.empty()) {
                all.push_back(
                    distributed(name + "_everywhere", name + "_local", _layout.servers, _database));
            }
        }
    }

    const StoreLayout& _layout;
    const std::string& _database;
};

void checkName(const std::string& name) {
    const bool isName = std::all_of(name.begin(), name.end(), [](char each) {
        return (each >= 'a' && each <= 'z') || (each >= 'A' && each <= 'Z') ||
               (each >= '0' && each <= '9') || each == '_';
    });
    if (!isName) {
        throw StoreFailure(formatText("\"%@\" is not the name of a cluster: it has letters, digits "
                                      "and _.",
                                      {name}));
    }
}

} // namespace

std::vector<std::string> storeSetup(const StoreLayout& layout, const std::string& database) {
    return Setup(layout, database).statements();
}

void setUpStore(const StoreAddress& address, const StoreLayout& layout) {
    checkName(layout.cluster);
    checkName(layout.servers);
    ClickHouse server(address);
    server.run("CREATE DATABASE IF NOT EXISTS " + address.database, false);
    for (const std::string& statement : storeSetup(layout, address.database)) {
        server.run(statement);
    }
}

} // namespace pallax
