#include "storing/ServerQuestions.h"

#include "text/Date.h"
#include "text/Format.h"

#include <array>
#include <chrono>

namespace pallax {

namespace {

// Of a row of `intervals`; see fleet/clickhouse.sql. They are in the query itself, and not in one
// below it, so that shards send sums and not rows.
constexpr const char* kSince =
    "((toInt64(day) * 1440 + minute) * 60000 + toInt64(second) * 1000 + ms)";
constexpr const char* kHeld =
    "(toInt64(hold_minutes) * 60000 + toInt64(hold_seconds) * 1000 + hold_ms)";
constexpr const char* kValue = "(steps * step + rest)";
constexpr const char* kCounts = "known = 1 AND hold_minutes + hold_seconds + hold_ms > 0";

/// What of a row is in the asked time.
struct Part {
    explicit Part(const AskedTime& time) {
        if (time.isAll()) {
            return;
        }
        std::string end = formatText("(%@ + %@)", {kSince, kHeld});
        if (time.from) {
            since = formatText("greatest(%@, toInt64(%lld))", {kSince, *time.from});
        }
        if (time.to) {
            end = formatText("least(%@, toInt64(%lld))", {end, *time.to});
        }
        held = formatText("(%@ - %@)", {end, since});
        counts += formatText(" AND %@ > 0", {held});
    }

    std::string since = kSince;
    std::string held = kHeld;
    std::string counts = kCounts; ///< whether there is a part with a number
};

std::string fieldsOf(const JudgedLevel& level) {
    std::string texts;
    for (const std::string& field : level.fields) {
        texts += (texts.empty() ? "" : ", ") + clickHouseText(field);
    }
    return texts;
}

std::string whereDevice(const StoreAskOptions& options) {
    return options.device ? " AND device = " + clickHouseText(*options.device) : "";
}

/// Whether a value is beyond a border; `relation` is "<" or ">=".
std::string isBeyond(const JudgedLevel& level, const std::string& relation,
                     const std::string& border) {
    const char* sign = level.borders.isSmallerBetter() ? "-1" : "1";
    return border == "NULL"
               ? "0"
               : formatText("%@ * %@ %@ %@ * %@", {kValue, sign, relation, border, sign});
}

/// hold, below, since and quantiles of the current values of a level.
std::string sumsOf(const JudgedLevel& level, const Part& part) {
    const std::string below =
        isBeyond(level, "<", level.border ? sqlNumber(*level.border) : "NULL");
    std::string sums = formatText(
        "nullIf(sumIf(%@, %@), 0) AS hold, sumIf(%@, %@ AND %@) AS below, if(below > 0, minIf(%@ * "
        "1000, %@ AND %@), NULL) AS since",
        {part.held, part.counts, part.held, part.counts, below, part.since, part.counts, below});
    for (const char* share : {"0.05", "0.5", "0.95"}) {
        sums +=
            formatText(", if(hold > 0, quantileExactWeightedIf(%@)(%@, toUInt64(%@), %@), NULL) "
                       "AS p%@",
                       {share, kValue, part.held, part.counts, std::string(share).substr(2)});
    }
    return sums;
}

const std::vector<std::string>& summaryColumns() {
    static const std::vector<std::string> names{"hold", "below", "since", "p05", "p5", "p95"};
    return names;
}
constexpr const char* kSummaryArray = "json_array(hold, below, since, p05, p5, p95)";

std::vector<std::string> operator+(std::vector<std::string> one,
                                   const std::vector<std::string>& other) {
    one.insert(one.end(), other.begin(), other.end());
    return one;
}

std::string unionOf(const std::vector<std::string>& queries) {
    std::string all;
    for (const std::string& query : queries) {
        all += (all.empty() ? "" : "\nUNION ALL ") + query;
    }
    return all;
}

ServerQuestion cellsQuestion(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels,
                             const AskedTime& time, const ServerStore& store) {
    const Part part(time);
    std::vector<std::string> queries;
    queries.reserve(levels.size());
    for (const JudgedLevel& level : levels) {
        queries.push_back(
            formatText("SELECT system, cell, %@ AS level, %@ AS border, uniqExactIf(device, %@) AS "
                       "devices, %@\n"
                       "FROM %@ WHERE field IN (%@) AND cell != '' AND %@%@ GROUP BY system, cell",
                       {clickHouseText(level.name),
                        level.border ? "toFloat64(" + sqlNumber(*level.border) + ")" : "NULL",
                        part.counts, sumsOf(level, part), store.table("intervals"), fieldsOf(level),
                        store.currentLoads(), whereDevice(options)}));
    }
    return {
        {{"sums",
          std::vector<std::string>{"system", "cell", "level", "border", "devices"} +
              summaryColumns(),
          unionOf(queries)}},
        "WITH judged AS (SELECT system, cell, level, border, json_array(hold, below, since, p05, "
        "p5, p95, devices) AS summary FROM sums)\n" +
            answerOf(options)};
}

/// Whether a row is of a device, a recording or a day with this name. `day` counts from 1970.
std::string isNamed(const std::string& word, const std::string& day) {
    const std::string name = clickHouseText(word);
    const auto date = parseIsoDate(word + "T00:00:00Z");
    std::string names = formatText("(device = %@ OR recording = %@", {name, name});
    if (date) {
        names += formatText(
            " OR %@ = %lld",
            {day, std::chrono::floor<std::chrono::days>(*date).time_since_epoch().count()});
    }
    return names + ")";
}

ServerQuestion compareQuestion(const StoreAskOptions& options,
                               const std::vector<JudgedLevel>& levels, const AskedTime& time,
                               const ServerStore& store) {
    const Part part(time);
    std::vector<std::string> sums;
    std::vector<std::string> events;
    for (std::size_t side = 0; side < options.words.size(); ++side) {
        const std::string& word = options.words[side];
        for (std::size_t level = 0; level < levels.size(); ++level) {
            sums.push_back(formatText(
                "SELECT %llu AS n, %llu AS side, %@ AS what, %@\nFROM %@ WHERE field IN (%@) AND "
                "%@ AND %@%@",
                {std::uint64_t{level + 1}, std::uint64_t{side + 1},
                 clickHouseText(levels[level].name), sumsOf(levels[level], part),
                 store.table("intervals"), fieldsOf(levels[level]), store.currentLoads(),
                 isNamed(word, "day"), whereDevice(options)}));
        }
        events.push_back(formatText(
            "SELECT %llu AS side, kind, count() AS times FROM %@ WHERE %@ AND %@%@%@%@ GROUP BY "
            "kind",
            {std::uint64_t{side + 1}, store.table("events"), store.currentLoads(),
             isNamed(word, "intDiv(time, 86400000000)"),
             time.from ? formatText(" AND intDiv(time, 1000) >= %lld", {*time.from}) : "",
             time.to ? formatText(" AND intDiv(time, 1000) < %lld", {*time.to}) : "",
             whereDevice(options)}));
    }
    return {
        {{"sums", std::vector<std::string>{"n", "side", "what"} + summaryColumns(), unionOf(sums)},
         {"times", {"side", "kind", "times"}, unionOf(events)}},
        formatText("WITH summed AS (SELECT n, side, what, %@ AS summary FROM sums),\n"
                   "happened AS (SELECT side, kind, times FROM times),\n%@",
                   {kSummaryArray, answerOf(options)})};
}

ServerQuestion coverageQuestion(const StoreAskOptions& options,
                                const std::vector<JudgedLevel>& levels, const AskedTime& time,
                                const ServerStore& store) {
    const Part part(time);
    std::vector<std::string> queries;
    queries.reserve(levels.size());
    for (const JudgedLevel& level : levels) {
        std::string sums;
        for (const Grade grade : {Grade::Excellent, Grade::Good, Grade::Fair, Grade::Poor}) {
            sums += formatText(", sumIf(%@, %@ AND %@) AS %@",
                               {part.held, part.counts,
                                isBeyond(level, ">=", borderOf(level, grade)), nameOf(grade)});
        }
        queries.push_back(formatText(
            "SELECT device, %@ AS level, sumIf(%@, %@) AS hold%@\nFROM %@ WHERE field "
            "IN (%@) AND %@%@ GROUP BY device",
            {clickHouseText(level.name), part.held, part.counts, sums, store.table("intervals"),
             fieldsOf(level), store.currentLoads(), whereDevice(options)}));
    }
    return {{{"sums",
              {"device", "level", "hold", "excellent", "good", "fair", "poor"},
              unionOf(queries)}},
            "WITH judged AS (SELECT device, level, json_array(hold, excellent, good, fair, poor) "
            "AS summary FROM sums)\n" +
                answerOf(options)};
}

/// An interval counts in each step that it touches, with the part of its time that is there.
ServerQuestion seriesQuestion(const StoreAskOptions& options,
                              const std::vector<JudgedLevel>& levels, const AskedTime& time,
                              const ServerStore& store) {
    const Part part(time);
    const std::string step = std::to_string(stepOf(options));
    const std::string begin = formatText("(%@ * 1000)", {part.since});
    const std::string end = formatText("(%@ + %@ * 1000)", {begin, part.held});
    const std::string pieces =
        formatText("WITH intDiv(%@, %@) + toInt64(arrayJoin(range(toUInt64(intDiv(%@ - 1, %@) - "
                   "intDiv(%@, %@) + 1)))) AS piece, least(%@, piece * %@ + %@) - greatest(%@, "
                   "piece * %@) AS part\n",
                   {begin, step, end, step, begin, step, end, step, step, begin, step});
    return {
        {{"summed",
          {"device", "entry", "step", "least", "weighted", "greatest", "hold"},
          pieces + formatText(
                       "SELECT device, nullIf(entry, '') AS words, piece, min(%@), sum(%@ * "
                       "part), max(%@), sum(part)\nFROM %@ WHERE field IN (%@) AND %@ AND "
                       "%@%@%@ GROUP BY device, entry, piece",
                       {kValue, kValue, kValue, store.table("intervals"), fieldsOf(levels.front()),
                        part.counts, store.currentLoads(), whereDevice(options),
                        options.entry ? " AND entry = " + clickHouseText(*options.entry) : ""})}},
        answerOf(options)};
}

} // namespace

ServerQuestion serverQuestion(const StoreAskOptions& options,
                              const std::vector<JudgedLevel>& levels, const AskedTime& time,
                              const ServerStore& store) {
    switch (options.question) {
    case StoreQuestion::Cells:
        return cellsQuestion(options, levels, time, store);
    case StoreQuestion::Series:
        return seriesQuestion(options, levels, time, store);
    case StoreQuestion::Compare:
        return compareQuestion(options, levels, time, store);
    case StoreQuestion::Coverage:
        return coverageQuestion(options, levels, time, store);
    default:
        return {{}, answerOf(options)}; // on `recordings`, which is always there
    }
}

} // namespace pallax
