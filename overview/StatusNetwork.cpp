#include "overview/StatusNetwork.h"

#include "fields/StatusFields.h"
#include "knowledge/CountryCodes.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

std::string trimmed(std::string text) {
    text.erase(text.find_last_not_of(' ') + 1);
    return text;
}

bool isTold(const CurrentValues& values, const StatusNetworkFields& rule) {
    const std::array fields{rule.name, rule.mcc, rule.code, rule.simName, rule.simNetwork};
    return std::any_of(fields.begin(), fields.end(), [&values](std::string_view field) {
        return !field.empty() && values.value(field) != nullptr;
    });
}

} // namespace

std::optional<StatusOperator> statusNetworkOf(const CurrentValues& values,
                                              const NetworkNames& names) {
    const auto rule =
        std::find_if(statusNetworks().begin(), statusNetworks().end(), [&values](const auto& each) {
            return each.technology == values.fields().technology() && isTold(values, each);
        });
    if (rule == statusNetworks().end()) {
        return std::nullopt;
    }
    const auto textOf = [&values](std::string_view field) {
        const FieldValue* value = field.empty() ? nullptr : values.value(field);
        return value != nullptr ? trimmed(value->text()) : std::string();
    };
    StatusOperator network;
    const auto home = NetworkCode::in(textOf(rule->simNetwork));
    network.code = rule->code.empty() ? NetworkCode::in(textOf(rule->mcc) + " " + textOf(rule->mnc))
                                      : NetworkCode::in(textOf(rule->code));
    if (!network.code) {
        network.code = home;
        network.isHome = home.has_value();
    }
    const std::string given = textOf(rule->name);
    const std::string stored = network.code == home ? textOf(rule->simName) : std::string();
    const NetworkCode code = network.code.value_or(NetworkCode());
    const auto operators = names.operatorsOf(code, {given, stored});
    if (!operators.empty()) {
        network.name = operators.front().name;
        network.source = operators.front().source;
    }
    const auto countries = countryCodesOf(code.mcc);
    if (!countries.empty()) {
        network.country = names.countryName(countries.front());
    }
    const bool isKnown = network.code || !network.name.empty();
    return isKnown ? std::optional(std::move(network)) : std::nullopt;
}

} // namespace pallax
