#include "decoding/FieldFacts.h"

#include "decoding/DisplayJson.h"
#include "text/Format.h"

namespace pallax {

namespace {

PropertyList rangeOf(const FieldInfo& field) {
    if (!field.least || !field.most) {
        return {};
    }
    return Dictionary{{"least", PropertyList::real(*field.least)},
                      {"most", PropertyList::real(*field.most)}};
}

Array codeNames(const FieldInfo& field) {
    Array codes;
    for (const LogCode code : field.codes) {
        codes.emplace_back(formatText("0x%04X", {code}));
    }
    return codes;
}

} // namespace

std::string rangeWord(const FieldInfo& field) {
    std::string word;
    if (field.least && field.most) {
        appendJson(word, PropertyList::real(*field.least));
        word += "..";
        appendJson(word, PropertyList::real(*field.most));
    }
    return word;
}

std::string marksWord(const FieldInfo& field) {
    std::string word;
    const auto mark = [&word](bool isMarked, std::string_view name) {
        if (isMarked) {
            word.append(word.empty() ? "" : ",").append(name);
        }
    };
    mark(field.identifies, "identity");
    mark(field.isPersonal, "personal");
    mark(!field.isShown, "hidden");
    return word;
}

Dictionary fieldObject(std::string_view technology, const FieldInfo& field) {
    return Dictionary{
        {"name", field.name},
        {"technology", std::string(technology)},
        {"path", field.path},
        {"section", field.section},
        {"key", field.key},
        {"kind", std::string(kindName(field.kind))},
        {"unit", field.unit.empty() ? PropertyList() : PropertyList(field.unit)},
        {"range", rangeOf(field)},
        {"meaning", field.meaning},
        {"labels", Array(field.labels.begin(), field.labels.end())},
        {"codes", codeNames(field)},
        {"identity", Array(field.identity.begin(), field.identity.end())},
        {"identifies", PropertyList::boolean(field.identifies)},
        {"personal", PropertyList::boolean(field.isPersonal)},
        {"shown", PropertyList::boolean(field.isShown)},
    };
}

} // namespace pallax
