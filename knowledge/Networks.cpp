#include "knowledge/Networks.h"

#include "text/Format.h"

#include <pugixml.hpp>

#include <algorithm>

namespace pallax {

namespace {

bool areDigits(std::string_view text) {
    return std::all_of(text.begin(), text.end(),
                       [](char character) { return character >= '0' && character <= '9'; });
}

constexpr std::size_t kMccDigits = 3;

bool isMnc(std::string_view text) {
    return (text.size() == 2 || text.size() == 3) && areDigits(text);
}

/// Loads a document and checks the name of its root; returns the reason if it cannot.
std::optional<std::string> load(pugi::xml_document& document, std::string_view xml,
                                std::string_view root) {
    const pugi::xml_parse_result result = document.load_buffer(xml.data(), xml.size());
    if (!result) {
        return formatText("%@ at byte %d", {result.description(), result.offset});
    }
    if (document.document_element().name() != root) {
        return formatText("it does not hold \"%@\"", {root});
    }
    return std::nullopt;
}

/// Keeps the main ones first, and one of equal names.
void addName(std::vector<OperatorName>& names, OperatorName added) {
    const bool isKnown = std::any_of(names.begin(), names.end(), [&](const OperatorName& each) {
        return each.name == added.name && each.country == added.country;
    });
    if (isKnown || added.name.empty()) {
        return;
    }
    const auto place = added.isMain
                           ? std::find_if(names.begin(), names.end(),
                                          [](const OperatorName& each) { return !each.isMain; })
                           : names.end();
    names.insert(place, std::move(added));
}

std::string lowerCase(std::string text) {
    for (char& character : text) {
        character = character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a')
                                                         : character;
    }
    return text;
}

} // namespace

std::optional<NetworkCode> NetworkCode::in(std::string_view text) {
    const std::string_view mcc = text.substr(0, kMccDigits);
    std::string_view mnc = text.substr(mcc.size());
    if (!mnc.empty() && std::string_view("- /").find(mnc.front()) != std::string_view::npos) {
        mnc.remove_prefix(1);
    }
    if (mcc.size() != kMccDigits || !areDigits(mcc) || !isMnc(mnc)) {
        return std::nullopt;
    }
    return NetworkCode{std::string(mcc), std::string(mnc)};
}

std::string_view nameOf(NameSource source) {
    switch (source) {
    case NameSource::Network:
        return "the network";
    case NameSource::Sim:
        return "the SIM";
    case NameSource::Database:
        break;
    }
    return "mobile-broadband-provider-info";
}

std::optional<std::string> NetworkNames::addProviders(std::string_view xml) {
    pugi::xml_document document;
    if (auto reason = load(document, xml, "serviceproviders")) {
        return reason;
    }
    for (const pugi::xml_node& country : document.document_element().children("country")) {
        const std::string code = country.attribute("code").value();
        _countries.emplace(code, country.child_value("name"));
        for (const pugi::xml_node& provider : country.children("provider")) {
            const bool isMain = provider.attribute("primary").as_bool();
            for (const pugi::xml_node& network : provider.child("gsm").children("network-id")) {
                const std::string mcc = network.attribute("mcc").value();
                const std::string mnc = network.attribute("mnc").value();
                if (mcc.size() == kMccDigits && areDigits(mcc) && isMnc(mnc)) {
                    addName(_operators[{mcc, mnc}],
                            {provider.child_value("name"), code, NameSource::Database, isMain});
                }
            }
        }
    }
    return std::nullopt;
}

std::optional<std::string> NetworkNames::addCountries(std::string_view xml) {
    pugi::xml_document document;
    if (auto reason = load(document, xml, "iso_3166_entries")) {
        return reason;
    }
    for (const pugi::xml_node& entry : document.document_element().children("iso_3166_entry")) {
        const pugi::xml_attribute common = entry.attribute("common_name");
        const std::string name = common ? common.value() : entry.attribute("name").value();
        if (!name.empty()) {
            _countries[lowerCase(entry.attribute("alpha_2_code").value())] = name;
        }
    }
    return std::nullopt;
}

std::vector<OperatorName> NetworkNames::operatorsOf(const NetworkCode& code,
                                                    const ReportedNames& reported) const {
    std::vector<OperatorName> names;
    addName(names, {std::string(reported.network), "", NameSource::Network});
    addName(names, {std::string(reported.sim), "", NameSource::Sim});
    if (const auto found = _operators.find(code); found != _operators.end()) {
        names.insert(names.end(), found->second.begin(), found->second.end());
    }
    return names;
}

std::vector<NetworkCode> NetworkNames::networksOf(std::string_view mcc) const {
    std::vector<NetworkCode> codes;
    for (const auto& [code, names] : _operators) {
        if (code.mcc == mcc && !names.empty()) {
            codes.push_back(code);
        }
    }
    return codes;
}

std::string NetworkNames::countryName(std::string_view country) const {
    const auto found = _countries.find(country);
    return found != _countries.end() ? found->second : "";
}

} // namespace pallax
