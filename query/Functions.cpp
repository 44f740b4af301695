#include "query/Functions.h"

#include "fields/Measures.h"
#include "knowledge/CellIdentity.h"
#include "knowledge/Channels.h"
#include "knowledge/Networks.h"
#include "query/Database.h"
#include "query/FieldNames.h"
#include "query/TimelineTables.h"
#include "text/Date.h"
#include "text/Format.h"
#include "text/Suggestion.h"

#include <algorithm>
#include <chrono>
#include <limits>
#include <map>
#include <memory>
#include <stdexcept>

namespace pallax {

namespace {

using Arguments = std::span<const QueryValue>;

std::optional<std::uint32_t> numberIn(const QueryValue& value) {
    const auto* number = std::get_if<std::int64_t>(&value);
    return number != nullptr && *number >= 0 && *number <= std::numeric_limits<std::uint32_t>::max()
               ? std::optional(static_cast<std::uint32_t>(*number))
               : std::nullopt;
}

std::optional<double> realIn(const QueryValue& value) {
    if (const auto* real = std::get_if<double>(&value)) {
        return *real;
    }
    const auto* number = std::get_if<std::int64_t>(&value);
    return number != nullptr ? std::optional(static_cast<double>(*number)) : std::nullopt;
}

std::optional<RadioSystem> systemIn(const QueryValue& value) {
    const auto* name = std::get_if<std::string>(&value);
    if (name == nullptr) {
        return std::nullopt;
    }
    const auto system = radioSystemNamed(*name);
    if (!system) {
        throw std::invalid_argument(
            formatText("\"%@\" is not one of gsm|umts|utran|lte|nr|cdma", {*name}));
    }
    return system;
}

QueryValue band(Arguments arguments) {
    const auto system = systemIn(arguments[0]);
    const auto number = numberIn(arguments[1]);
    if (!system || !number) {
        return {};
    }
    std::string text = bandText(*system, *number);
    return text.empty() ? QueryValue() : QueryValue(std::move(text));
}

QueryValue mhz(Arguments arguments) {
    const auto system = systemIn(arguments[0]);
    const auto number = numberIn(arguments[1]);
    const auto frequency = system && number ? megahertz(*system, *number) : std::nullopt;
    return frequency ? QueryValue(*frequency) : QueryValue();
}

QueryValue cellSite(Arguments arguments) {
    const auto system = systemIn(arguments[0]);
    const auto number = numberIn(arguments[1]);
    if (system && number && *system == RadioSystem::Lte) {
        const auto cell = lteCell(*number);
        return cell ? QueryValue(std::int64_t{cell->eNodeB}) : QueryValue();
    }
    if (system && number && *system == RadioSystem::UmtsFdd) {
        const auto cell = umtsCell(*number);
        return cell ? QueryValue(std::int64_t{cell->rnc}) : QueryValue();
    }
    return {};
}

/// Digits of a text, or a number with leading zeros up to `width` digits.
std::string digitsIn(const QueryValue& value, std::size_t width) {
    if (const auto* text = std::get_if<std::string>(&value)) {
        return *text;
    }
    const auto number = numberIn(value);
    std::string digits = number ? std::to_string(*number) : std::string();
    return digits.empty() || digits.size() >= width
               ? digits
               : std::string(width - digits.size(), '0') + digits;
}

QueryValue operatorName(Arguments arguments, const NetworkNames* names) {
    constexpr std::size_t kMccDigits = 3;
    constexpr std::size_t kMncDigits = 2;
    const auto code = NetworkCode::in(digitsIn(arguments[0], kMccDigits) + "-" +
                                      digitsIn(arguments[1], kMncDigits));
    if (!code || names == nullptr) {
        return {};
    }
    const auto operators = names->operatorsOf(*code);
    return operators.empty() ? QueryValue() : QueryValue(operators.front().name);
}

QueryValue timeText(Arguments arguments) {
    const auto* time = std::get_if<std::int64_t>(&arguments[0]);
    if (time == nullptr) {
        return {};
    }
    const auto latest =
        std::chrono::floor<std::chrono::microseconds>(kLatestTime.time_since_epoch()).count();
    return isoTimeText(Time(std::chrono::microseconds(std::clamp<std::int64_t>(*time, 0, latest))));
}

/// What fields measure, by the names that queries give them.
class MeasureNames {
public:
    explicit MeasureNames(const FieldTable* fields) : _fields(fields) {}

    /// Nothing for a field that no profile can judge.
    std::optional<Measure> find(const std::string& name) {
        auto found = _found.find(name);
        if (found == _found.end()) {
            found = _found.emplace(name, read(name)).first;
        }
        return found->second;
    }

private:
    std::optional<Measure> read(const std::string& name) const {
        if (const auto measure = measureOf(name)) {
            return measure;
        }
        if (const auto measure = measureNamed(name)) {
            return measure;
        }
        std::optional<Measure> measure;
        std::vector<std::string> names;
        for (const MeasuredField& field : measuredFields()) {
            if (_fields != nullptr && !_fields->named(field.name)) {
                continue; // of another technology
            }
            names.push_back(lastWordOf(std::string(field.name)));
            if (names.back() != name) {
                continue;
            }
            if (measure && *measure != field.measure) {
                throw std::invalid_argument(
                    formatText("\"%@\" can be \"%@\" or \"%@\"",
                               {name, infoOf(*measure).name, infoOf(field.measure).name}));
            }
            measure = field.measure;
        }
        if (!measure && (_fields == nullptr || FieldNames(*_fields).all(name).empty())) {
            throw std::invalid_argument(unknown(name, std::move(names)));
        }
        return measure;
    }
    std::string unknown(std::string_view name, std::vector<std::string> names) const {
        for (const MeasureInfo& each : kMeasures) {
            names.emplace_back(each.name);
        }
        return _fields != nullptr
                   ? unknownField(*_fields, name, std::move(names))
                   : formatText("\"%@\" is not a field", {name}) + suggestion(name, names);
    }

    const FieldTable* _fields;
    std::map<std::string, std::optional<Measure>, std::less<>> _found; ///< asked for each row
};

/// Judges values by profiles, each of which it asks for once.
class Judge {
public:
    Judge(QueryKnowledge knowledge, const FieldTable* fields)
        : _knowledge(std::move(knowledge)), _measures(fields) {}

    QueryValue quality(Arguments arguments) {
        const auto* field = std::get_if<std::string>(&arguments[0]);
        const auto* named =
            arguments.size() > 2 ? std::get_if<std::string>(&arguments[2]) : nullptr;
        if (field == nullptr || (arguments.size() > 2 && named == nullptr)) {
            return {};
        }
        const auto measure = _measures.find(*field);
        const auto value = realIn(arguments[1]);
        if (!measure || !value) {
            return {};
        }
        const auto grade =
            profile(named != nullptr ? *named : kDefaultProfile).gradeOf(*measure, *value);
        return grade ? QueryValue(std::string(nameOf(*grade))) : QueryValue();
    }

private:
    const QualityProfile& profile(std::string_view name) {
        auto found = _profiles.find(name);
        if (found == _profiles.end()) {
            auto profile = _knowledge.profile ? _knowledge.profile(name) : std::nullopt;
            if (!profile) {
                throw std::invalid_argument(formatText("there is no profile \"%@\"", {name}));
            }
            found = _profiles.emplace(name, *std::move(profile)).first;
        }
        return found->second;
    }

    QueryKnowledge _knowledge;
    MeasureNames _measures;
    std::map<std::string, QualityProfile, std::less<>> _profiles;
};

} // namespace

void addFunctions(Database& database, QueryKnowledge knowledge, const FieldTable* fields) {
    constexpr int kThree = 3;
    database.addFunction("band", 2, band);
    database.addFunction("mhz", 2, mhz);
    database.addFunction("cell_site", 2, cellSite);
    database.addFunction("time_text", 1, timeText);
    database.addFunction("operator", 2, [names = knowledge.names](Arguments arguments) {
        return operatorName(arguments, names ? names() : nullptr);
    });
    const auto judge = std::make_shared<Judge>(std::move(knowledge), fields);
    const auto quality = [judge](Arguments arguments) { return judge->quality(arguments); };
    database.addFunction("quality", 2, quality);
    database.addFunction("quality", kThree, quality);
}

} // namespace pallax
