#pragma once

#include "knowledge/Quality.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

class Database;
class FieldTable;
class NetworkNames;

/// What the functions know beside tables of their own.
struct QueryKnowledge {
    /// The names of networks; null without any. Called at the first use. Without it there are none.
    std::function<const NetworkNames*()> names = {};
    /// The profile of that name, or nothing. Without it there are none.
    std::function<std::optional<QualityProfile>(std::string_view name)> profile = {};
};

/// Adds the functions that know what numbers mean. They return NULL where there is no answer, and
/// for arguments that are NULL:
///
/// - band(technology, channel), mhz(technology, channel): "3", 1870.0; the technology is that of
///   `pallax explain` (gsm, umts, utran, lte, nr, cdma);
/// - operator(mcc, mnc): the name of a network; an MNC is a text of two or three digits, or a
///   number, which stands for two;
/// - cell_site(technology, identity): the eNodeB or the RNC of a cell identity;
/// - quality(field, value) and quality(field, value, profile): "good"; the field goes by its name,
///   its last word or what it measures ("rsrp"). Only a field that no profile can judge gives NULL;
///   a name that is none, or has several measures, is an error;
/// - time_text(time): "2023-11-14T22:13:20.000Z".
///
/// `fields` are those of the recording and must outlive the database; without them, quality() knows
/// the fields of all technologies.
void addFunctions(Database& database, QueryKnowledge knowledge, const FieldTable* fields = nullptr);

} // namespace pallax
