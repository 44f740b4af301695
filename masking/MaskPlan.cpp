#include "masking/MaskPlan.h"

#include "decoding/FieldSelection.h"
#include "fields/PlaceFields.h"
#include "platform/RecordedTechnology.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

/// Whether a name of a command line means the field: its whole name or its end.
bool isMeant(const FieldInfo& field, const std::string& name) {
    return isNamed(field.name, name) || isNamed(field.name, "*." + name);
}

bool isAmong(const FieldInfo& field, const std::vector<std::string>& names) {
    return std::any_of(names.begin(), names.end(),
                       [&field](const std::string& name) { return isMeant(field, name); });
}

/// The keys that lead to the field; its own may hold a slash ("EF-GPRS/PS-LOCI").
std::vector<std::string> stepsOf(const FieldInfo& field) {
    std::vector<std::string> steps;
    const std::string around = field.path.substr(0, field.path.size() - field.key.size());
    std::size_t begin = 1; // after the first slash
    while (begin < around.size()) {
        const std::size_t end = std::min(around.find('/', begin), around.size());
        steps.push_back(around.substr(begin, end - begin));
        begin = end + 1;
    }
    if (!field.key.empty()) {
        steps.push_back(field.key);
    }
    return steps;
}

bool matches(const std::string& step, const std::string& key) {
    return step == kEntryName || step == key;
}

/// Whether `path` leads through the steps, beginning with the first; unless `isExact`, other keys
/// may stand between and after them.
bool leadsThrough(const ScalarPath& path, const std::vector<std::string>& steps, bool isExact) {
    std::size_t next = 0;
    for (const std::string& key : path) {
        if (next < steps.size() && matches(steps[next], key)) {
            ++next;
        } else if (next == 0 || (isExact && next < steps.size())) {
            return false;
        }
    }
    return next == steps.size();
}

} // namespace

MaskPlan::MaskPlan(const RecordedTechnology& technology, const Resources& resources,
                   const MaskChoice& choice)
    : _reference(gatherReference(technology, resources)), _registry(_reference),
      _keepsUnknown(choice.keepUnknown) {
    for (const SectionReference& section : _reference.sections) {
        for (const CodeDescription& code : section.codes) {
            _byCode[code.logCode].push_back(&code);
        }
    }
    for (const FieldInfo& field : _registry.fields()) {
        const MaskAction action = actionOf(field, choice);
        for (const FieldId row : field.rows) {
            _rows[row] = {action, &field};
        }
        if (action != MaskAction::Keep) {
            _shown.push_back({stepsOf(field), action, field.kind == FieldInfo::Kind::Object});
        }
    }
    for (const auto& [logCode, codes] : _byCode) {
        for (const CodeDescription* code : codes) {
            if (masksIn(*code) ||
                std::any_of(code->subpackets.begin(), code->subpackets.end(),
                            [this](const auto& each) { return this->masksIn(each); })) {
                _masked.insert(code);
            }
        }
    }
}

template <class Described>
bool MaskPlan::masksIn(const Described& parts) const {
    return std::any_of(parts.fields.begin(), parts.fields.end(),
                       [this](const auto& each) { return of(each.row) != MaskAction::Keep; }) ||
           std::any_of(parts.lists.begin(), parts.lists.end(),
                       [this](const auto& each) { return this->masksIn(each); });
}

MaskAction MaskPlan::actionOf(const FieldInfo& field, const MaskChoice& choice) const {
    if (isAmong(field, choice.keep)) {
        return MaskAction::Keep;
    }
    if (field.isPersonal || isAmong(field, choice.also)) {
        return MaskAction::Mask;
    }
    const auto places = placeFields();
    const bool isPlace = std::find(places.begin(), places.end(), field.name) != places.end();
    return choice.coarsePlace && isPlace ? MaskAction::Place : MaskAction::Keep;
}

const std::vector<const CodeDescription*>& MaskPlan::codes(LogCode code) const {
    static const std::vector<const CodeDescription*> none;
    const auto found = _byCode.find(code);
    return found != _byCode.end() ? found->second : none;
}

MaskAction MaskPlan::of(FieldId row) const {
    const auto found = _rows.find(row);
    return found != _rows.end() ? found->second.action : MaskAction::Keep;
}

const std::string& MaskPlan::nameOf(FieldId row) const {
    static const std::string none;
    const auto found = _rows.find(row);
    return found != _rows.end() ? found->second.field->name : none;
}

MaskAction MaskPlan::ofPayload(const CodeDescription& code, const ScalarPath& path) const {
    const MaskAction unknown = _keepsUnknown ? MaskAction::Keep : MaskAction::Mask;
    const auto withKey = [&](std::size_t depth) {
        return std::find_if(code.fields.begin(), code.fields.end(), [&](const auto& field) {
            return path.size() > depth && field.listKey == path[depth];
        });
    };
    switch (code.listPart->kind) {
    case ListPart::Kind::Keys: {
        // Other files of a SIM may hold anything, such as the IMSI.
        const auto field = withKey(0);
        return field != code.fields.end() ? of(field->row) : unknown;
    }
    case ListPart::Kind::Elements:
        return of(code.fields.front().row);
    default:
        break;
    }
    const auto field = withKey(1);
    return field != code.fields.end() ? of(field->row) : MaskAction::Keep;
}

MaskAction MaskPlan::ofDisplay(const ScalarPath& path) const {
    MaskAction action = MaskAction::Keep;
    for (const Shown& shown : _shown) {
        const bool mayHaveMore = areObjects() || shown.isObject;
        if ((mayHaveMore || path.size() == shown.path.size()) &&
            leadsThrough(path, shown.path, !areObjects())) {
            action = std::max(action, shown.action);
        }
    }
    return action;
}

std::optional<std::string> MaskPlan::unknownName(const MaskChoice& choice,
                                                 const Resources& resources) {
    std::vector<FieldInfo> all;
    for (const RecordedTechnology& technology : recordedTechnologies()) {
        const FieldRegistry registry(gatherReference(technology, resources));
        all.insert(all.end(), registry.fields().begin(), registry.fields().end());
    }
    for (const auto* names : {&choice.keep, &choice.also}) {
        for (const std::string& name : *names) {
            if (std::none_of(all.begin(), all.end(),
                             [&name](const FieldInfo& field) { return isMeant(field, name); })) {
                return name;
            }
        }
    }
    return std::nullopt;
}

bool isPersonalKey(std::string_view key) {
    constexpr auto kWords = std::to_array<std::string_view>(
        {"_iccid_", "_msisdn_", "_tlli_", "_guti_", "_meid_", "_esn_", "_own_number_",
         "_phone_number_", "_pdp_address_", "_ip_address_", "_subscriber_", "_mdn_"});
    constexpr auto kParts = std::to_array<std::string_view>({"imsi", "imei", "tmsi"}); // "IMEISV"
    const std::string word = "_" + fieldWord(key) + "_";
    const auto isIn = [&word](std::string_view each) {
        return word.find(each) != std::string::npos;
    };
    return std::any_of(kWords.begin(), kWords.end(), isIn) ||
           std::any_of(kParts.begin(), kParts.end(), isIn);
}

} // namespace pallax
