#include "fields/CellFields.h"
#include "fields/StatusFields.h"
#include "knowledge/CellIdentity.h"
#include "knowledge/CountryCodes.h"
#include "overview/StatusWords.h"
#include "overview/ValueFacts.h"
#include "text/Format.h"

#include <algorithm>
#include <cmath>

namespace pallax {

namespace {

/// The system whose channels a field tells.
std::optional<RadioSystem> systemOfChannel(const FieldInfo& field) {
    for (const CellFields& cell : cellFields()) {
        if (cell.channel == field.name) {
            return cell.system;
        }
    }
    return std::nullopt;
}

/// The role of a field in a status, with the system.
struct StatusRole {
    RadioSystem system;
    StatusField::Role role;
};
std::optional<StatusRole> roleOf(const CurrentValues& values, const FieldInfo& field) {
    const auto isOther = [&values](const StatusCondition& only) {
        const FieldValue* value = only.field.empty() ? nullptr : values.value(only.field);
        return value != nullptr && value->text() != only.text;
    };
    for (const StatusCellFields& cell : statusCells()) {
        if (cell.isList || isOther(cell.only)) {
            continue;
        }
        for (const StatusField& each : cell.fields) {
            if (each.field == field.name) {
                return StatusRole{cell.system, each.role};
            }
        }
    }
    return std::nullopt;
}

bool isBsic(const FieldInfo& field) {
    const auto cells = cellFields();
    return std::any_of(cells.begin(), cells.end(), [&field](const CellFields& cell) {
        return cell.system == RadioSystem::Gsm && cell.code == field.name &&
               cell.networkColour.empty();
    });
}

/// "band 3", "downlink 1870.0 MHz", "uplink 1775.0 MHz"; of a number with several meanings, those
/// that its meanings share.
std::vector<std::string> wordsOfChannel(RadioSystem system, std::uint32_t number) {
    std::vector<std::string> words;
    const std::vector<Carrier> carriers = carriersOf(system, number);
    if (carriers.empty()) {
        return words;
    }
    words.push_back("band " + bandText(system, number));
    if (carriers.size() > 1) {
        if (const auto frequency = megahertz(system, number)) {
            constexpr double kHertz = 1e6;
            words.push_back(megahertzText(static_cast<Hertz>(std::llround(*frequency * kHertz))) +
                            " MHz");
        }
        return words;
    }
    const auto add = [&words](std::string_view direction, const std::optional<Channel>& channel) {
        if (channel) {
            words.push_back(formatText("%@ %@ MHz", {direction, megahertzText(channel->hertz)}));
        }
    };
    add("downlink", carriers.front().downlink);
    add("uplink", carriers.front().uplink);
    return words;
}

/// The code of a network that a field tells, alone or with its other part.
std::optional<NetworkCode> networkOf(const CurrentValues& values, const FieldInfo& field,
                                     const FieldValue& value) {
    for (const StatusNetworkFields& rule : statusNetworks()) {
        if (field.name == rule.simNetwork || (!rule.code.empty() && field.name == rule.code)) {
            return NetworkCode::in(value.text());
        }
        if (field.name == rule.mcc || field.name == rule.mnc) {
            const FieldValue* mcc = values.value(rule.mcc);
            const FieldValue* mnc = values.value(rule.mnc);
            return mcc != nullptr && mnc != nullptr
                       ? NetworkCode::in(mcc->text() + " " + mnc->text())
                       : std::nullopt;
        }
    }
    return std::nullopt;
}

std::string networkWords(const NetworkCode& code, const NetworkNames& names) {
    StatusOperator network;
    network.code = code;
    const auto operators = names.operatorsOf(code);
    network.name = operators.empty() ? "" : operators.front().name;
    const auto countries = countryCodesOf(code.mcc);
    network.country = countries.empty() ? "" : names.countryName(countries.front());
    return operatorWords(network);
}

} // namespace

std::vector<std::string> knowledgeOf(const CurrentValues& values, const FieldInfo& field,
                                     const FieldValue& value, const NetworkNames& names) {
    const auto number = wholeNumber(value.number);
    const auto role = roleOf(values, field);
    const bool isChannel = role && role->role == StatusField::Role::Channel;
    const auto system = isChannel ? role->system : systemOfChannel(field);
    if (system && number) {
        return wordsOfChannel(*system, *number);
    }
    if (role && role->role == StatusField::Role::Site) {
        const std::string words = siteWords(role->system, value.number);
        return words.empty() ? std::vector<std::string>() : std::vector<std::string>{words};
    }
    if (const auto codes = number && isBsic(field) ? colourCodesOf(*number) : std::nullopt) {
        return {formatText("network colour code %u", {codes->ncc}),
                formatText("base station colour code %u", {codes->bcc})};
    }
    if (const auto network = networkOf(values, field, value)) {
        return {networkWords(*network, names)};
    }
    return {};
}

} // namespace pallax
