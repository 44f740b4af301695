#pragma once

#include "query/Database.h"
#include "query/TimelineTables.h"
#include "tests/timeline/TimelineFixture.h"
#include "text/Format.h"

#include <memory>
#include <string>
#include <variant>
#include <vector>

namespace pallax {

inline std::string textOf(const QueryValue& value) {
    if (const auto* number = std::get_if<std::int64_t>(&value)) {
        return std::to_string(*number);
    }
    if (const auto* real = std::get_if<double>(&value)) {
        return formatText("%.6f", {*real});
    }
    const auto* text = std::get_if<std::string>(&value);
    return text != nullptr ? *text : "NULL";
}

/// A row a line, values separated by "|"; of an error, its sentence.
inline std::vector<std::string> linesOf(Database& database, const std::string& text) {
    auto query = database.prepare(text);
    if (!query) {
        return {query.error().sentence};
    }
    auto running = std::move(query).value();
    std::vector<std::string> lines;
    while (true) {
        auto row = running.next();
        if (!row) {
            lines.push_back(row.error().sentence);
            return lines;
        }
        if (!*row) {
            return lines;
        }
        std::string line;
        for (const QueryValue& value : **row) {
            line += (line.empty() ? "" : "|") + textOf(value);
        }
        lines.push_back(line);
    }
}

/// The tables of a simulated drive.
class QueryFixture : public TimelineFixture {
public:
    QueryFixture(std::string_view technologyName, std::uint64_t seed, std::chrono::seconds duration)
        : TimelineFixture(technologyName) {
        drive(seed, duration);
        timeline = indexed();
        addTimelineTables(database, *timeline);
    }

    std::vector<std::string> ask(const std::string& text) { return linesOf(database, text); }

    std::unique_ptr<Timeline> timeline;
    Database database;
};

} // namespace pallax
