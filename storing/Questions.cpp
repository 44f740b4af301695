#include "storing/Questions.h"

#include "fields/Measures.h"
#include "fields/StatusFields.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace pallax {

namespace {

std::string numberText(double number) {
    std::array<char, 40> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number);
    return {digits.data(), end.ptr};
}

bool isEndOf(const std::string& words, std::string_view field) {
    return field == words || field.ends_with("." + words);
}

JudgedLevel judged(std::string_view field, std::string_view name, Measure measure,
                   std::optional<double> below, const QualityProfile& profile) {
    JudgedLevel level{std::string(field), std::string(name), below};
    const auto borders = profile.borders.find(measure);
    if (borders != profile.borders.end()) {
        level.isSmallerBetter = borders->second.isSmallerBetter();
        for (const Borders::Border& border : borders->second.borders) {
            if (!below && border.grade >= Grade::Fair) {
                level.border = border.value;
            }
        }
    }
    return level;
}

/// "AND device = 'car1'", with the name of the column.
std::string onlyDevice(const StoreAskOptions& options) {
    return options.device ? " AND device = " + quotedText(*options.device) : "";
}

/// A common table of the levels: field, level, border and the sign that makes greater better.
std::string levelTable(const std::vector<JudgedLevel>& levels) {
    std::string rows;
    for (const JudgedLevel& level : levels) {
        rows +=
            formatText("%@(%@, %@, %@, %@)",
                       {rows.empty() ? "" : ", ", quotedText(level.field), quotedText(level.name),
                        level.border ? numberText(*level.border) : std::string("NULL"),
                        level.isSmallerBetter ? "-1" : "1"});
    }
    return "WITH level(field, level, border, sign) AS (VALUES " + rows + ")\n";
}

constexpr const char* kHours = "round(sum(hold) / 3.6e9, 3)";
constexpr const char* kShareBelow =
    "round(100.0 * sum(CASE WHEN number * sign < border * sign THEN hold ELSE 0 END) / sum(hold), "
    "1)";
constexpr const char* kQuantiles = "quantile(number, hold, 0.05) AS p5, "
                                   "quantile(number, hold, 0.5) AS p50, "
                                   "quantile(number, hold, 0.95) AS p95";

std::string cellsQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels) {
    return levelTable(levels) +
           formatText("SELECT system, cell, level, count(DISTINCT device) AS devices, %@ AS hours, "
                      "border, %@ AS below_percent, time_text(min(CASE WHEN number * sign < "
                      "border * sign THEN start END)) AS since, %@\n"
                      "FROM level JOIN measurement USING (field)\n"
                      "WHERE cell IS NOT NULL AND number IS NOT NULL AND hold > 0%@\n"
                      "GROUP BY system, cell, level\n"
                      "ORDER BY below_percent DESC, hours DESC, system, cell",
                      {kHours, kShareBelow, kQuantiles, onlyDevice(options)});
}

std::string compareQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels) {
    const auto is = [](const std::string& word) {
        return formatText("%@ IN (device, recording, substr(time_text(start), 1, 10))",
                          {quotedText(word)});
    };
    const std::string& one = options.words.at(0);
    const std::string& other = options.words.at(1);
    return levelTable(levels) +
           formatText(
               ", side AS (SELECT 1 AS side, %@ AS name UNION ALL SELECT 2, %@),\n"
               "part AS (SELECT side, level, number, hold, border, sign FROM level JOIN "
               "measurement USING (field) JOIN side ON CASE side WHEN 1 THEN %@ ELSE %@ END\n"
               "WHERE number IS NOT NULL AND hold > 0%@),\n",
               {quotedText(one), quotedText(other), is(one), is(other), onlyDevice(options)}) +
           formatText("row AS (SELECT side, level, %@ AS hours, %@ AS below_percent, %@\n"
                      "FROM part GROUP BY level, side)\n"
                      "SELECT level, name, hours, below_percent, p5, p50, p95,\n"
                      "round(p50 - lag(p50) OVER (PARTITION BY level ORDER BY side), 2) AS change\n"
                      "FROM row JOIN side USING (side) ORDER BY level, side",
                      {kHours, kShareBelow, kQuantiles});
}

std::string seriesQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels) {
    const auto step = std::chrono::duration_cast<std::chrono::microseconds>(options.every).count();
    const std::string entry =
        options.entry ? " AND entry = " + quotedText(*options.entry) : std::string();
    const std::string text = std::to_string(step);
    // Each interval is divided where steps begin.
    return "WITH RECURSIVE part(device, entry, step, start, stop, number) AS (\n"
           "SELECT device, entry, start / " +
           text +
           ", start, start + hold, number\n"
           "FROM measurement WHERE field = " +
           quotedText(levels.front().field) + " AND number IS NOT NULL AND hold > 0" +
           onlyDevice(options) + entry +
           "\n"
           "UNION ALL SELECT device, entry, step + 1, (step + 1) * " +
           text +
           ", stop, number\n"
           "FROM part WHERE stop > (step + 1) * " +
           text +
           "),\n"
           "held AS (SELECT device, entry, step, number, min(stop, (step + 1) * " +
           text +
           ") - "
           "start AS hold FROM part)\n"
           "SELECT time_text(step * " +
           text +
           ") AS time, device, entry, min(number) AS least, "
           "round(sum(number * hold) / sum(hold), 2) AS mean, max(number) AS greatest, "
           "round(100.0 * sum(hold) / " +
           text +
           ", 1) AS known_percent\n"
           "FROM held GROUP BY device, entry, step ORDER BY device, entry, step";
}

std::string coverageQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels) {
    std::string grades;
    for (const Grade grade :
         {Grade::Excellent, Grade::Good, Grade::Fair, Grade::Poor, Grade::None}) {
        const std::string name(nameOf(grade));
        grades += ", round(100.0 * sum(CASE grade WHEN '" + name +
                  "' THEN hold ELSE 0 END) / sum(hold), 1) AS " + name;
    }
    return levelTable(levels) +
           formatText("SELECT device, system, level, %@ AS hours%@\n"
                      "FROM (SELECT device, system, level, sum(hold) AS hold, "
                      "quality(field, number, %@) AS grade\n"
                      "FROM level JOIN measurement USING (field)\n"
                      "WHERE number IS NOT NULL AND hold > 0%@\n"
                      "GROUP BY device, system, level, field, number)\n"
                      "GROUP BY device, system, level ORDER BY device, system, level",
                      {kHours, grades, quotedText(options.profile), onlyDevice(options)});
}

} // namespace

std::string quotedText(const std::string& text) {
    std::string quoted = "'";
    for (const char character : text) {
        quoted.append(character == '\'' ? 2 : 1, character);
    }
    return quoted + "'";
}

std::vector<JudgedLevel> judgedLevels(const std::string& choice, std::optional<double> below,
                                      const QualityProfile& profile) {
    std::vector<JudgedLevel> levels;
    const auto add = [&](std::string_view field, std::string_view name) {
        const bool isKnown = std::any_of(levels.begin(), levels.end(),
                                         [&](const auto& level) { return level.field == field; });
        const auto measure = measureOf(field);
        if (measure && !isKnown) {
            levels.push_back(judged(field, name, *measure, below, profile));
        }
    };
    const auto asked = measureNamed(choice);
    for (const StatusCellFields& cell : statusCells()) {
        for (const StatusField& field : cell.fields) {
            const bool isWanted = choice.empty() || (asked && measureOf(field.field) == asked);
            if (field.role == StatusField::Role::Level && isWanted) {
                add(field.field, field.name);
            }
        }
    }
    if (choice.empty() || asked) {
        return levels;
    }
    for (const MeasuredField& each : measuredFields()) {
        if (isEndOf(choice, each.name)) {
            add(each.name, each.name);
        }
    }
    return levels;
}

std::string queryOf(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels) {
    switch (options.question) {
    case StoreAskOptions::Question::Devices:
        return "SELECT device, count(*) AS recordings, time_text(min(first) * 1000) AS first, "
               "time_text(max(last) * 1000) AS last, round(sum(last - first) / 3.6e6, 3) AS hours, "
               "sum(packets) AS packets FROM recordings WHERE true" +
               onlyDevice(options) + " GROUP BY device ORDER BY device";
    case StoreAskOptions::Question::Recordings:
        return "SELECT device, name, technology, time_text(first * 1000) AS first, "
               "time_text(last * 1000) AS last, packets, every, identities, decoder, trouble "
               "FROM recordings WHERE true" +
               onlyDevice(options) + " ORDER BY device, first, name";
    case StoreAskOptions::Question::Cells:
        return cellsQuery(options, levels);
    case StoreAskOptions::Question::Series:
        return seriesQuery(options, levels);
    case StoreAskOptions::Question::Compare:
        return compareQuery(options, levels);
    case StoreAskOptions::Question::Coverage:
        return coverageQuery(options, levels);
    case StoreAskOptions::Question::Sql:
        break;
    }
    return options.words.at(0);
}

} // namespace pallax
