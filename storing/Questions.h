#pragma once

#include "knowledge/Quality.h"
#include "storing/StoreOptions.h"
#include "text/Result.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// A level of cells, which one or several fields tell.
struct JudgedLevel {
    std::string name; ///< "LTE RSRP"; of a field that no status shows, its own
    std::vector<std::string> fields;
    Borders borders;              ///< of the profile; empty if it does not judge the level
    std::optional<double> border; ///< where it begins to be bad; nothing: unknown
};

/// The levels that a question is about: those that the status shows of serving cells, those of one
/// measure, or one field by its name or the end of it. Nothing if `choice` is none of these.
std::vector<JudgedLevel> judgedLevels(const std::string& choice, std::optional<double> below,
                                      const QualityProfile& profile);

/// As SQL has it.
std::string sqlNumber(double number);

/// Where a grade or a better one ends; "NULL" if there is none.
std::string borderOf(const JudgedLevel& level, Grade grade);

/// The length of a step of a series in microseconds.
std::int64_t stepOf(const StoreAskOptions& options);

/// The times that a question is about, in milliseconds since 1970. Nothing: all times.
struct AskedTime {
    std::optional<std::int64_t> from = {};
    std::optional<std::int64_t> to = {};

    bool isAll() const { return !from && !to; }
};

/// A section's table, with its columns.
struct AskedSection {
    std::string table; ///< as SQL has it: lte."serving_cell_measurements"
    std::vector<std::string> fields;
    bool isList = false;
};

/// The query for what a section showed.
std::string sectionQuery(const StoreAskOptions& options, const AskedSection& section,
                         const AskedTime& time);

/// The query that answers a question about other things, on the tables and views of a store.
std::string queryOf(const StoreAskOptions& options, const std::vector<JudgedLevel>& levels,
                    const AskedTime& time);

/// The last part of that query, which makes the answer of sums that may come from elsewhere: of the
/// tables `judged` (cells, coverage), `summed` and `happened` (compare), `summed` (series) or
/// `recordings`.
std::string answerOf(const StoreAskOptions& options);

} // namespace pallax
