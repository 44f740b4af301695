#include "fields/FieldRegistry.h"

#include "platform/RecordedTechnology.h"

#include <algorithm>
#include <cmath>
#include <set>
#include <tuple>
#include <utility>

namespace pallax {

namespace {

/// The least and the greatest raw number that fit a position.
std::pair<double, double> rawRange(const Position& position) {
    const unsigned magnitude = position.isSigned ? position.width - 1 : position.width;
    const double beyond = std::ldexp(1.0, static_cast<int>(magnitude));
    return {position.isSigned ? -beyond : 0.0, beyond - 1};
}

double shownNumber(const Conversion& conversion, double raw) {
    const double number = raw * conversion.factor / conversion.divisor + conversion.offset;
    return conversion.format->isReal() ? number : std::trunc(number);
}

void addLabel(std::vector<std::string>& labels, std::string_view label) {
    if (!label.empty() && std::find(labels.begin(), labels.end(), label) == labels.end()) {
        labels.emplace_back(label);
    }
}

FieldInfo::Kind kindOf(const FieldDescription& field) {
    if (field.shownAs.format != nullptr) {
        return FieldInfo::Kind::Number;
    }
    const bool isElement = field.key.empty() && !field.position && field.formula.empty();
    if (!field.listKey.empty() || isElement) {
        return FieldInfo::Kind::Object;
    }
    return field.position ? FieldInfo::Kind::Label : FieldInfo::Kind::Text;
}

/// What the numbers of a field have in common, over all its rows.
struct Numbers {
    std::set<std::string_view> units;
    bool areLimited = true;
};

void addNumber(FieldInfo& info, Numbers& numbers, const FieldDescription& field) {
    const Conversion& conversion = field.shownAs;
    numbers.units.insert(conversion.format->unit());
    // Values that come in different units, each with its own in the text, have none in common.
    info.unit = numbers.units.size() == 1 ? conversion.format->unit() : std::string_view();
    numbers.areLimited = numbers.areLimited && field.position.has_value();
    if (!numbers.areLimited) {
        info.least.reset();
        info.most.reset();
        return;
    }
    const auto [rawLeast, rawMost] = rawRange(*field.position);
    const double least = shownNumber(conversion, rawLeast);
    const double most = shownNumber(conversion, rawMost);
    info.least = std::min({least, most, info.least.value_or(least)});
    info.most = std::max({least, most, info.most.value_or(most)});
}

/// Adds a row to its field.
void addRow(FieldInfo& info, Numbers& numbers, const FieldDescription& field,
            const FieldInfo::Place& place) {
    const Conversion& conversion = field.shownAs;
    if (conversion.format != nullptr) {
        addNumber(info, numbers, field);
    }
    for (const std::string_view label : conversion.labels) {
        addLabel(info.labels, label);
    }
    addLabel(info.labels, conversion.exceptionalText);
    addLabel(info.labels, conversion.beyond);
    if (!conversion.labels.empty() || !conversion.exceptionalText.empty() ||
        !conversion.beyond.empty()) {
        info.labelled.push_back(conversion);
    }
    if (field.condition && field.condition->otherwise.find('%') == std::string_view::npos) {
        addLabel(info.labels, field.condition->otherwise);
        if (field.condition->otherwise != conversion.beyond) {
            addLabel(info.otherwise, field.condition->otherwise);
        }
    }
    if (std::find(info.codes.begin(), info.codes.end(), place.code) == info.codes.end()) {
        info.codes.push_back(place.code);
    }
    info.identifies = info.identifies || field.identifies;
    info.isPersonal = info.isPersonal || field.isPersonal;
    info.rows.push_back(field.row);
    info.places.push_back(place);
}

/// Walks the sections of a technology.
class Gatherer {
public:
    explicit Gatherer(const TechnologyReference& technology)
        : _technology(technology), _prefix(std::string(technology.technology->commandName) + ".") {}

    std::vector<FieldInfo> gathered() {
        const bool isObjectStream = codesOf(_technology).empty();
        for (const SectionReference& section : _technology.sections) {
            _section = &section;
            _name = _prefix + fieldWord(section.name);
            _path = section.path;
            for (const CodeDescription& code : section.codes) {
                addCode(code);
            }
            for (const ObjectKey& key : section.objectKeys) {
                addObjectKey(key);
            }
            if (isObjectStream && section.objectKeys.empty()) {
                // The section is the value itself, or a list of values that identify themselves.
                addObjectKey({.name = "", .isIdentifying = section.isList});
            }
        }
        addIdentities();
        return std::move(_fields);
    }

private:
    void addCode(const CodeDescription& code) {
        const bool isEntries = code.listPart && code.listPart->isEntries();
        const std::string path = _path;
        _path += isEntries ? "/*" : "";
        _isInList = isEntries;
        addParts(code.fields, code.lists, {code.logCode, false});
        for (const SubpacketDescription& subpacket : code.subpackets) {
            addParts(subpacket.fields, subpacket.lists, {code.logCode, true});
        }
        _path = path;
        _isInList = false;
    }

    void addParts(const std::vector<FieldDescription>& fields,
                  const std::vector<ListDescription>& lists, const FieldInfo::Place& place) {
        for (const FieldDescription& field : fields) {
            FieldInfo& info = infoOf(field.key, kindOf(field));
            addRow(info, _numbers[info.name], field, place);
        }
        for (const ListDescription& list : lists) {
            addList(list, place);
        }
    }

    void addList(const ListDescription& list, const FieldInfo::Place& place) {
        const auto around = std::tuple(_name, _path, _listKey, _isInList, _isShown);
        if (!list.key.empty()) {
            _listKey = list.key;
            _name += "." + fieldWord(list.key);
            _path += "/" + list.key;
        }
        _path += "/*";
        _isInList = true;
        _isShown = _isShown && list.isShown;
        if (list.entryName) {
            _identities[_path] = {std::string(kEntryName)};
        }
        addParts(list.fields, list.lists, place);
        std::tie(_name, _path, _listKey, _isInList, _isShown) = around;
    }

    void addObjectKey(const ObjectKey& key) {
        const std::string path = _path;
        _isInList = _section->isList;
        _path += _isInList ? "/*" : "";
        FieldInfo& info = infoOf(key.name, !key.unit.empty()    ? FieldInfo::Kind::Number
                                           : key.labels.empty() ? FieldInfo::Kind::Text
                                                                : FieldInfo::Kind::Label);
        for (const std::string_view label : key.labels) {
            addLabel(info.labels, label);
        }
        info.identifies = key.isIdentifying;
        info.isPersonal = key.isPersonal;
        info.unit = key.unit;
        _path = path;
        _isInList = false;
    }

    /// The field with that key, added at its first row.
    FieldInfo& infoOf(const std::string& key, FieldInfo::Kind kind) {
        std::string name = key.empty() ? _name : _name + "." + fieldWord(key);
        const auto found = std::find_if(_fields.begin(), _fields.end(),
                                        [&](const FieldInfo& each) { return each.name == name; });
        if (found != _fields.end()) {
            found->isShown = found->isShown || _isShown;
            return *found;
        }
        FieldInfo& info = _fields.emplace_back();
        info.name = std::move(name);
        info.path = key.empty() ? _path : _path + "/" + key;
        info.section = _section->name;
        info.key = key;
        info.kind = kind;
        info.meaning = meaningOf(key);
        info.isInList = _isInList;
        info.isShown = _isShown;
        return info;
    }

    /// A plain value has the meaning of its list; a list without a key is the section, if the
    /// section is a list.
    std::string_view meaningOf(const std::string& key) const {
        if (key.empty() && _listKey.empty() && _isInList != _section->isList) {
            return {};
        }
        return _technology.meaningOf(_section->name, key.empty() ? _listKey : key);
    }

    /// The path of the entries of the field's list.
    static std::string entryPathOf(const FieldInfo& field) {
        constexpr std::string_view kAnyEntry = "/*";
        return field.path.substr(0, field.path.rfind(kAnyEntry) + kAnyEntry.size());
    }

    void addIdentities() {
        for (const FieldInfo& field : _fields) {
            if (field.identifies) {
                _identities[entryPathOf(field)].push_back(field.name);
            }
        }
        for (FieldInfo& field : _fields) {
            if (field.isInList) {
                field.identity = _identities[entryPathOf(field)];
            }
        }
    }

    const TechnologyReference& _technology;
    std::map<std::string, Numbers> _numbers; ///< by the field's name
    std::string _prefix;
    std::vector<FieldInfo> _fields;
    const SectionReference* _section = nullptr;
    std::string _name;
    std::string _path;
    std::string _listKey; ///< of the innermost list with a key
    std::map<std::string, std::vector<std::string>> _identities; ///< by the path of the entries
    bool _isInList = false;
    bool _isShown = true;
};

} // namespace

std::string_view FieldInfo::labelOf(std::int64_t raw) const {
    std::string_view unknown;
    for (const Conversion& conversion : labelled) {
        const SampleValue value = conversion.valueOf(raw);
        if (value.number() == nullptr && value.words() != conversion.beyond) {
            return value.words();
        }
        if (value.number() == nullptr && unknown.empty()) {
            unknown = value.words(); // another row may know the number
        }
    }
    return unknown;
}

FieldRegistry::FieldRegistry(const TechnologyReference& technology)
    : _fields(Gatherer(technology).gathered()) {
    for (std::size_t index = 0; index < _fields.size(); ++index) {
        _byName.emplace(_fields[index].name, index);
        for (const FieldId row : _fields[index].rows) {
            _byRow.emplace(row, index);
        }
    }
}

const FieldInfo* FieldRegistry::ofRow(FieldId row) const {
    const auto found = _byRow.find(row);
    return found != _byRow.end() ? &_fields[found->second] : nullptr;
}

const FieldInfo* FieldRegistry::named(std::string_view name) const {
    const auto found = _byName.find(name);
    return found != _byName.end() ? &_fields[found->second] : nullptr;
}

std::string_view kindName(FieldInfo::Kind kind) {
    switch (kind) {
    case FieldInfo::Kind::Number:
        return "number";
    case FieldInfo::Kind::Label:
        return "label";
    case FieldInfo::Kind::Text:
        return "text";
    case FieldInfo::Kind::Object:
        break;
    }
    return "object";
}

std::string fieldWord(std::string_view text) {
    std::string word;
    for (const char character : text) {
        const bool isCapital = character >= 'A' && character <= 'Z';
        const bool isWord = isCapital || (character >= 'a' && character <= 'z') ||
                            (character >= '0' && character <= '9');
        if (isWord) {
            word.push_back(isCapital ? static_cast<char>(character - 'A' + 'a') : character);
        } else if (!word.empty() && word.back() != '_') {
            word.push_back('_');
        }
    }
    return !word.empty() && word.back() == '_' ? word.substr(0, word.size() - 1) : word;
}

} // namespace pallax
