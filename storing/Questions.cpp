#include "storing/Questions.h"

#include "fields/Measures.h"
#include "fields/StatusFields.h"
#include "query/SqlText.h"
#include "text/Date.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <charconv>

namespace pallax {

namespace {

bool isEndOf(const std::string& words, std::string_view field) {
    return field == words || field.ends_with("." + words);
}

JudgedLevel judged(std::string name, Measure measure, std::optional<double> below,
                   const QualityProfile& profile) {
    JudgedLevel level{std::move(name), {}, {}, below};
    const auto borders = profile.borders.find(measure);
    if (borders != profile.borders.end()) {
        level.borders = borders->second;
        for (const Borders::Border& border : level.borders.borders) {
            if (!below && border.grade >= Grade::Fair) {
                level.border = border.value;
            }
        }
    }
    return level;
}

/// " AND r.device = 'car1'".
std::string onlyDevice(const StoreAskOptions& options) {
    return options.device ? " AND r.device = " + quotedText(*options.device) : "";
}

/// Common tables: `level` has each level with its borders and the sign that makes a greater value
/// better, `member` its fields.
std::string levelTables(const std::vector<JudgedLevel>& levels) {
    std::string rows;
    std::string members;
    for (std::size_t index = 0; index < levels.size(); ++index) {
        const JudgedLevel& level = levels[index];
        const std::string number = std::to_string(index + 1);
        rows.append(rows.empty() ? "(" : ", (").append(number);
        rows.append(", ").append(quotedText(level.name)).append(", ");
        rows.append(level.border ? sqlNumber(*level.border) : "NULL");
        rows.append(level.borders.isSmallerBetter() ? ", -1" : ", 1");
        for (const Grade grade : {Grade::Excellent, Grade::Good, Grade::Fair, Grade::Poor}) {
            rows.append(", ").append(borderOf(level, grade));
        }
        rows += ")";
        for (const std::string& field : level.fields) {
            members.append(members.empty() ? "(" : ", (").append(number).append(", ");
            members.append(quotedText(field)).append(")");
        }
    }
    return "WITH level(n, level, border, sign, excellent, good, fair, poor) AS (VALUES " + rows +
           "),\nnamed(n, name) AS (VALUES " + members +
           "),\nmember AS (SELECT n, id AS field FROM named JOIN fields USING (name)),\n";
}

/// The part of an interval that is in the asked time.
struct Clipped {
    /// `start` and `end` are expressions in units of which a millisecond has `unit`.
    Clipped(const AskedTime& time, std::string itsStart, std::string itsEnd, std::int64_t unit)
        : start(std::move(itsStart)), end(std::move(itsEnd)) {
        if (time.from) {
            const std::string from = std::to_string(*time.from * unit);
            condition += formatText(" AND %@ > %@", {end, from});
            start = formatText("max(%@, %@)", {start, from});
        }
        if (time.to) {
            const std::string to = std::to_string(*time.to * unit);
            condition += formatText(" AND %@ < %@", {start, to});
            end = formatText("min(%@, %@)", {end, to});
        }
    }

    std::string start;
    std::string end;
    std::string condition = {}; ///< " AND …": whether there is a part
};

/// The values of the current level that a condition on recordings `r` and sites `s.site` leaves.
std::string levelValues(const std::string& condition, const AskedTime& time) {
    const Clipped part(time, "(r.first + i.time)", "(r.first + i.time + i.hold)", 1);
    const Clipped series(time, "(r.first + s.first)", "(r.first + s.last)", 1);
    return formatText(
        "FROM (SELECT %@ - %@ AS hold, CASE typeof(i.number) WHEN 'integer' THEN "
        "i.number * s.step ELSE i.number END AS number, %@ * 1000 AS start, "
        "r.device\n"
        "FROM member m CROSS JOIN series s ON s.field = m.field "
        "CROSS JOIN recordings r ON r.id = s.recording "
        "CROSS JOIN intervals i ON i.id BETWEEN s.first_row AND s.last_row\n"
        "WHERE m.n = l.n AND i.number IS NOT NULL AND i.hold > 0%@%@%@)",
        {part.end, part.start, part.start, series.condition, part.condition, condition});
}

/// The same for questions that do not look at times within recordings: of all times, each number
/// is one row.
std::string levelTotals(const std::string& condition, const AskedTime& time) {
    return !time.isAll()
               ? levelValues(condition, time)
               : "FROM (SELECT s.hold, s.number, (r.first + s.first) * 1000 AS start, r.device\n"
                 "FROM member m CROSS JOIN totals s ON s.field = m.field "
                 "CROSS JOIN recordings r ON r.id = s.recording WHERE m.n = l.n" +
                     condition + ")";
}

// Several sums of one pass over the values, as elements of a JSON array.
constexpr const char* kSummary =
    "SELECT json_array(sum(hold), sum(CASE WHEN number * sign < border * sign THEN hold ELSE 0 "
    "END), min(CASE WHEN number * sign < border * sign THEN start END), "
    "quantile(number, hold, 0.05), quantile(number, hold, 0.5), quantile(number, hold, 0.95), "
    "count(DISTINCT device))\n";
constexpr const char* kHours = "round((summary ->> 0) / 3.6e6, 3) AS hours";
constexpr const char* kShareBelow =
    "round(100.0 * (summary ->> 1) / (summary ->> 0), 1) AS below_percent";
constexpr const char* kQuantiles =
    "summary ->> 3 AS p5, summary ->> 4 AS p50, summary ->> 5 AS p95";

/// Of the table `judged`.
std::string cellsAnswer() {
    return formatText("SELECT system, cell, level, summary ->> 6 AS devices, %@, border, %@, "
                      "time_text(summary ->> 2) AS since, %@\n"
                      "FROM judged WHERE summary ->> 0 > 0\n"
                      "ORDER BY below_percent DESC, hours DESC, system, cell, level",
                      {kHours, kShareBelow, kQuantiles});
}

std::string cellsQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels,
                       const AskedTime& time) {
    return levelTables(levels) +
           formatText("judged AS MATERIALIZED (SELECT p.system, p.identity AS cell, l.level, "
                      "l.border, (%@%@) AS summary\n"
                      "FROM sites p CROSS JOIN level l)\n",
                      {kSummary, levelTotals(" AND s.site = p.id" + onlyDevice(options), time)}) +
           cellsAnswer();
}

/// Whether a row is of a device, a recording or a day with this name.
std::string isOf(const std::string& word, const std::string& milliseconds) {
    const std::string name = quotedText(word);
    std::string names = name + " IN (r.device, r.name)";
    if (!parseIsoDate(word + "T00:00:00Z")) {
        return names;
    }
    return formatText("(%@ OR %@ / 86400000 = unixepoch(%@) / 86400)", {names, milliseconds, name});
}

/// Of the tables `summed` and `happened`, which come before it.
std::string compareAnswer(const StoreAskOptions& options) {
    return formatText("name(side, name) AS (VALUES (1, %@), (2, %@)),\n"
                      "known AS (SELECT side, max(summary ->> 0) / 3.6e6 AS hours FROM summed "
                      "GROUP BY side),\n",
                      {quotedText(options.words.at(0)), quotedText(options.words.at(1))}) +
           formatText("both AS (SELECT n, side, what, %@, %@, %@, NULL AS per_hour, summary ->> 4 "
                      "AS middle FROM summed WHERE summary ->> 0 > 0\nUNION ALL "
                      "SELECT 1000, side, kind, round(hours, 3), NULL, NULL, NULL, NULL, "
                      "round(times / hours, 2), round(times / hours, 2) FROM happened JOIN known "
                      "USING (side))\n",
                      {kHours, kShareBelow, kQuantiles}) +
           "SELECT what, name, hours, below_percent, p5, p50, p95, per_hour, round(middle - "
           "lag(middle) OVER (PARTITION BY n, what ORDER BY side), 2) AS change\n"
           "FROM both JOIN name USING (side) ORDER BY n, what, side";
}

/// Levels, and events by the hour of what was recorded.
std::string compareQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels,
                         const AskedTime& time) {
    std::string summaries;
    std::string events;
    for (std::size_t side = 0; side < options.words.size(); ++side) {
        const std::string number = std::to_string(side + 1);
        const std::string& word = options.words[side];
        summaries += formatText(
            "%@SELECT l.n, %@ AS side, l.level AS what, (%@%@) AS summary FROM level l",
            {side == 0 ? "" : " UNION ALL ", number, kSummary,
             levelValues(" AND " + isOf(word, "(r.first + i.time)") + onlyDevice(options), time)});
        events += formatText("%@SELECT %@ AS side, kind, count(*) AS times FROM recordings r JOIN "
                             "events e ON e.recording = r.id WHERE %@%@%@ GROUP BY kind",
                             {side == 0 ? "" : " UNION ALL ", number, isOf(word, "e.time / 1000"),
                              Clipped(time, "(e.time / 1000)", "(e.time / 1000 + 1)", 1).condition,
                              onlyDevice(options)});
    }
    return levelTables(levels) +
           formatText("summed AS MATERIALIZED (%@),\nhappened AS MATERIALIZED (%@),\n",
                      {summaries, events}) +
           compareAnswer(options);
}

/// The few intervals that are in several steps are divided where these begin.
constexpr const char* kSeries =
    R"(WITH RECURSIVE part(device, entry, step, start, stop, number) AS (
    SELECT device, entry, start / STEP, start, start + hold, number
        FROM VALUES AND start / STEP < (start + hold - 1) / STEP
    UNION ALL SELECT device, entry, step + 1, (step + 1) * STEP, stop, number
        FROM part WHERE stop > (step + 1) * STEP),
held AS (
    SELECT device, entry, step, number, min(stop, (step + 1) * STEP) - start AS hold FROM part
    UNION ALL SELECT device, entry, start / STEP, number, hold
        FROM VALUES AND start / STEP = (start + hold - 1) / STEP),
summed AS (
    SELECT device, entry, step, min(number) AS least, sum(1.0 * number * hold) AS weighted,
        max(number) AS greatest, sum(hold) AS hold
        FROM held GROUP BY device, entry, step)
)";

/// Of the table `summed`.
constexpr const char* kSeriesAnswer =
    R"(SELECT time_text(step * STEP) AS time, device, entry, least, round(weighted / hold, 2) AS mean,
    greatest, round(100.0 * hold / STEP, 1) AS known_percent
FROM summed ORDER BY device, entry, step)";

/// The text with each such word replaced.
std::string replaced(std::string_view text, std::string_view word, const std::string& by) {
    std::string result;
    for (std::size_t at = text.find(word); at != std::string_view::npos; at = text.find(word)) {
        result.append(text.substr(0, at)).append(by);
        text.remove_prefix(at + word.size());
    }
    return result.append(text);
}

std::string withStep(const std::string& text, const StoreAskOptions& options) {
    return replaced(text, "STEP", std::to_string(stepOf(options)));
}

std::string seriesQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels,
                        const AskedTime& time) {
    constexpr std::int64_t kMicroseconds = 1000;
    const Clipped part(time, "start", "(start + hold)", kMicroseconds);
    const std::string values = formatText(
        "(SELECT device, entry, %@ AS start, %@ - %@ AS hold, number FROM measurement WHERE field "
        "= %@ AND number IS NOT NULL AND hold > 0%@%@%@) WHERE true",
        {part.start, part.end, part.start, quotedText(levels.front().fields.front()),
         part.condition, options.device ? " AND device = " + quotedText(*options.device) : "",
         options.entry ? " AND entry = " + quotedText(*options.entry) : ""});
    return withStep(replaced(kSeries, "VALUES", values) + kSeriesAnswer, options);
}

constexpr std::array kGrades{Grade::Excellent, Grade::Good, Grade::Fair, Grade::Poor};

/// Of the table `judged`.
std::string coverageAnswer() {
    std::string shares;
    for (std::size_t grade = 0; grade < kGrades.size(); ++grade) {
        const std::string better = grade == 0 ? "0" : "(summary ->> " + std::to_string(grade) + ")";
        shares += formatText(", round(100.0 * ((summary ->> %llu) - %@) / (summary ->> 0), 1) "
                             "AS %@",
                             {std::uint64_t{grade + 1}, better, nameOf(kGrades.at(grade))});
    }
    return formatText("SELECT device, level, %@%@, round(100.0 * ((summary ->> 0) - (summary ->> "
                      "%llu)) / (summary ->> 0), 1) AS none\n"
                      "FROM judged WHERE summary ->> 0 > 0 ORDER BY device, level",
                      {kHours, shares, std::uint64_t{kGrades.size()}});
}

std::string coverageQuery(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels,
                          const AskedTime& time) {
    std::string sums = "sum(hold)";
    for (const Grade grade : kGrades) { // those of this grade or a better one
        sums += formatText(", sum(CASE WHEN number * sign >= %@ * sign THEN hold ELSE 0 END)",
                           {nameOf(grade)});
    }
    return levelTables(levels) +
           formatText("judged AS MATERIALIZED (SELECT d.device, l.level, "
                      "(SELECT json_array(%@)\n%@) AS summary\n"
                      "FROM (SELECT DISTINCT device FROM recordings r WHERE true%@) d "
                      "CROSS JOIN level l)\n",
                      {sums, levelTotals(" AND r.device = d.device", time), onlyDevice(options)}) +
           coverageAnswer();
}

} // namespace

std::string sqlNumber(double number) {
    std::array<char, 40> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), number);
    return {digits.data(), end.ptr};
}

std::string borderOf(const JudgedLevel& level, Grade grade) {
    std::string text = "NULL";
    for (const Borders::Border& border : level.borders.borders) { // the best first
        if (border.grade >= grade) {
            text = sqlNumber(border.value);
        }
    }
    return text;
}

std::vector<JudgedLevel> judgedLevels(const std::string& choice, std::optional<double> below,
                                      const QualityProfile& profile) {
    std::vector<JudgedLevel> levels;
    const auto add = [&](std::string_view field, const std::string& name) {
        const auto measure = measureOf(field);
        if (!measure) {
            return;
        }
        auto level = std::find_if(levels.begin(), levels.end(),
                                  [&](const JudgedLevel& each) { return each.name == name; });
        if (level == levels.end()) {
            level = levels.insert(level, judged(name, *measure, below, profile));
        }
        if (std::find(level->fields.begin(), level->fields.end(), field) == level->fields.end()) {
            level->fields.emplace_back(field);
        }
    };
    const auto asked = measureNamed(choice);
    for (const StatusCellFields& cell : statusCells()) {
        for (const StatusField& field : cell.fields) {
            const bool isWanted = choice.empty() || (asked && measureOf(field.field) == asked);
            if (field.role == StatusField::Role::Level && isWanted) {
                add(field.field, std::string(cell.name) + " " + std::string(field.name));
            }
        }
    }
    for (const MeasuredField& each : measuredFields()) {
        if (!choice.empty() && !asked && isEndOf(choice, each.name)) {
            add(each.name, std::string(each.name));
        }
    }
    return levels;
}

std::int64_t stepOf(const StoreAskOptions& options) {
    return std::chrono::duration_cast<std::chrono::microseconds>(options.every).count();
}

std::string answerOf(const StoreAskOptions& options) {
    switch (options.question) {
    case StoreQuestion::Cells:
        return cellsAnswer();
    case StoreQuestion::Series:
        return withStep(kSeriesAnswer, options);
    case StoreQuestion::Compare:
        return compareAnswer(options);
    case StoreQuestion::Coverage:
        return coverageAnswer();
    default:
        return queryOf(options, {}, {}); // of the table `recordings`
    }
}

std::string sectionQuery(const StoreAskOptions& options, const AskedSection& section,
                         const AskedTime& time) {
    std::string query = "SELECT time_text(time) AS time, device, recording, system, cell, ";
    query += section.isList ? "entry, " : "";
    query += "round(hold / 1e6, 3) AS seconds";
    for (const std::string& field : section.fields) {
        query += ", " + quotedName(field);
    }
    query += " FROM " + section.table + " WHERE true";
    constexpr std::int64_t kMicroseconds = 1000;
    query += time.from ? " AND time >= " + std::to_string(*time.from * kMicroseconds) : "";
    query += time.to ? " AND time <= " + std::to_string(*time.to * kMicroseconds) : "";
    query += options.device ? " AND device = " + quotedText(*options.device) : "";
    return query + (options.entry ? " AND entry = " + quotedText(*options.entry) : "");
}

std::string queryOf(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels,
                    const AskedTime& time) {
    switch (options.question) {
    case StoreQuestion::Devices:
        return "SELECT device, count(*) AS recordings, time_text(min(first) * 1000) AS first, "
               "time_text(max(last) * 1000) AS last, round(sum(last - first) / 3.6e6, 3) AS hours, "
               "sum(packets) AS packets FROM recordings r WHERE true" +
               onlyDevice(options) + " GROUP BY device ORDER BY device";
    case StoreQuestion::Recordings:
        return "SELECT device, name, technology, time_text(first * 1000) AS first, "
               "time_text(last * 1000) AS last, packets, every, identities, decoder, trouble "
               "FROM recordings r WHERE true" +
               onlyDevice(options) + " ORDER BY device, first, name";
    case StoreQuestion::Cells:
        return cellsQuery(options, levels, time);
    case StoreQuestion::Series:
        return seriesQuery(options, levels, time);
    case StoreQuestion::Compare:
        return compareQuery(options, levels, time);
    case StoreQuestion::Coverage:
        return coverageQuery(options, levels, time);
    case StoreQuestion::Section:
    case StoreQuestion::Sql:
        break;
    }
    return options.words.at(0);
}

} // namespace pallax
