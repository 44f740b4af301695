#include "explaining/Topics.h"
#include "host/KnowledgeFiles.h"
#include "knowledge/CountryCodes.h"
#include "text/Format.h"

#include <algorithm>

namespace pallax {

namespace {

void noteWhatIsMissing(Answers& answers, const InstalledNames& installed) {
    answers.notes = installed.complaints;
    if (!installed.names.hasOperators() && installed.complaints.empty()) {
        answers.notes.emplace_back("The names of networks are not installed (Debian package "
                                   "mobile-broadband-provider-info).");
    }
    if (!installed.names.hasCountries() && installed.complaints.empty()) {
        answers.notes.emplace_back(
            "The names of countries are not installed (Debian package iso-codes).");
    }
}

/// "Germany (de)", or the code alone.
std::string countryText(const NetworkNames& names, std::string_view code) {
    const std::string name = names.countryName(code);
    return name.empty() ? std::string(code) : formatText("%@ (%@)", {name, code});
}

PropertyList countryObject(const NetworkNames& names, std::string_view code) {
    const std::string name = names.countryName(code);
    return Dictionary{{"code", std::string(code)},
                      {"name", name.empty() ? PropertyList() : PropertyList(name)}};
}

void addCountries(Answer& answer, const NetworkNames& names,
                  const std::vector<std::string>& countries) {
    Array objects;
    for (const std::string& country : countries) {
        answer.rows.push_back({"country", countryText(names, country)});
        objects.push_back(countryObject(names, country));
    }
    answer.object.set("countries", std::move(objects));
}

/// The countries of the operators, else those of the code.
std::vector<std::string> countriesOf(const NetworkCode& code,
                                     const std::vector<OperatorName>& operators) {
    std::vector<std::string> countries;
    for (const OperatorName& each : operators) {
        if (std::find(countries.begin(), countries.end(), each.country) == countries.end()) {
            countries.push_back(each.country);
        }
    }
    if (countries.empty()) {
        for (const std::string_view country : countryCodesOf(code.mcc)) {
            countries.emplace_back(country);
        }
    }
    return countries;
}

void addOperators(Answer& answer, const std::vector<OperatorName>& operators,
                  const std::vector<std::string>& countries, bool areInstalled) {
    Array objects;
    for (const OperatorName& each : operators) {
        const bool isElsewhereToo = countries.size() > 1;
        answer.rows.push_back({objects.empty() ? "operator" : "also",
                               each.name + (isElsewhereToo ? " (" + each.country + ")" : "")});
        objects.emplace_back(Dictionary{{"name", each.name},
                                        {"country", each.country},
                                        {"main", PropertyList::boolean(each.isMain)},
                                        {"source", std::string(nameOf(each.source))}});
    }
    if (operators.empty()) {
        answer.rows.push_back({"operator", areInstalled ? "not listed" : "unknown"});
    } else {
        answer.rows.push_back({"source", std::string(nameOf(operators.front().source))});
    }
    answer.object.set("operators", std::move(objects));
}

AnswersResult explainCode(const NetworkCode& code, const Library& library) {
    const InstalledNames installed = readInstalledNames(library.dataFolders);
    const std::vector<OperatorName> operators = installed.names.operatorsOf(code);
    const std::vector<std::string> countries = countriesOf(code, operators);
    if (countries.empty()) {
        return unknown(formatText("No country has the mobile country code %@.", {code.mcc}));
    }
    Answer answer{formatText("network %@-%@", {code.mcc, code.mnc}),
                  {},
                  {{"about", "network"}, {"mcc", code.mcc}, {"mnc", code.mnc}}};
    addOperators(answer, operators, countries, installed.names.hasOperators());
    addCountries(answer, installed.names, countries);
    Answers answers{{answer}};
    noteWhatIsMissing(answers, installed);
    return answers;
}

/// One operator can have an entry in each of several countries.
std::vector<std::string> differentNames(const std::vector<OperatorName>& operators) {
    std::vector<std::string> names;
    for (const OperatorName& each : operators) {
        if (std::find(names.begin(), names.end(), each.name) == names.end()) {
            names.push_back(each.name);
        }
    }
    return names;
}

AnswersResult explainMcc(std::string_view topic, Words operands, const Library& library) {
    constexpr std::size_t kDigits = 3;
    const std::string& mcc = operands[0];
    if (mcc.size() != kDigits || !numberIn(topic, mcc)) {
        return misused(formatText("a mobile country code has three digits, unlike \"%@\"", {mcc}));
    }
    const InstalledNames installed = readInstalledNames(library.dataFolders);
    const auto codes = countryCodesOf(mcc);
    if (codes.empty()) {
        return unknown(formatText("No country has the mobile country code %@.", {mcc}));
    }
    Answer answer{"mobile country code " + mcc, {}, {{"about", "mcc"}, {"mcc", mcc}}};
    addCountries(answer, installed.names, {codes.begin(), codes.end()});
    Array networks;
    for (const NetworkCode& code : installed.names.networksOf(mcc)) {
        const std::vector<std::string> names = differentNames(installed.names.operatorsOf(code));
        std::string list;
        for (const std::string& name : names) {
            list.append(list.empty() ? "" : ", ").append(name);
        }
        answer.rows.push_back({code.mcc + "-" + code.mnc, list});
        networks.emplace_back(
            Dictionary{{"mnc", code.mnc}, {"names", Array(names.begin(), names.end())}});
    }
    answer.object.set("networks", std::move(networks));
    Answers answers{{answer}};
    noteWhatIsMissing(answers, installed);
    return answers;
}

} // namespace

std::optional<AnswersResult> explainNetwork(Words words, const Library& library) {
    constexpr std::size_t kMostWords = 2;
    if (words.empty() || words.size() > kMostWords) {
        return std::nullopt;
    }
    const auto code =
        NetworkCode::in(words.size() == 1 ? words[0] : formatText("%@ %@", {words[0], words[1]}));
    return code ? std::optional(explainCode(*code, library)) : std::nullopt;
}

std::vector<Topic> networkTopics() {
    return {{"mcc", "a mobile country code", 1, 1, explainMcc}};
}

} // namespace pallax
