#include "fields/Description.h"

#include <optional>
#include <utility>

namespace pallax {

namespace {

template <class Value>
std::optional<Value> copyOf(const Value* value) {
    return value != nullptr ? std::optional<Value>(*value) : std::nullopt;
}

FieldDescription describeField(const Field& field) {
    FieldDescription description{std::string(field.key), field.position, field.conversion};
    description.listKey = field.listKey;
    description.listBits = field.listBits;
    if (const Computation* computation = field.computation) {
        description.formula = computation->formula;
        description.computation = computation->name;
        description.read.assign(computation->read.begin(), computation->read.end());
        description.counters.assign(computation->counters.begin(), computation->counters.end());
    }
    description.condition = copyOf(field.condition);
    description.identifies = field.identifies;
    description.isPersonal = field.isPersonal;
    description.meaning = field.meaning;
    return description;
}

std::vector<FieldDescription> describeFields(std::span<const Field> fields) {
    std::vector<FieldDescription> descriptions;
    for (const Field& field : fields) {
        descriptions.push_back(describeField(field));
    }
    return descriptions;
}

ListDescription describe(const ListLayout& layout);

std::vector<ListDescription> describe(std::span<const ListLayout> lists) {
    std::vector<ListDescription> descriptions;
    for (const ListLayout& list : lists) {
        descriptions.push_back(describe(list));
    }
    return descriptions;
}

ListDescription describe(const ListLayout& layout) {
    ListDescription list;
    list.key = layout.key;
    list.entries = layout.entries;
    list.count = layout.count;
    list.plus = layout.plus;
    list.fit = layout.fit;
    list.sizeCheck = layout.sizeCheck;
    list.fields = describeFields(layout.fields);
    list.lists = describe(layout.lists);
    list.only = copyOf(layout.only);
    list.companion = layout.companion;
    list.entryName = layout.entryName;
    list.ifEmpty = layout.ifEmpty;
    list.formula = layout.formula;
    list.varying = layout.varying;
    list.staysWithoutEntries = layout.staysWithoutEntries;
    list.isShown = layout.isShown;
    list.rememberedAs = layout.rememberedAs;
    list.meaning = layout.meaning;
    return list;
}

void numberRows(std::vector<FieldDescription>& fields, std::vector<ListDescription>& lists,
                FieldId& next) {
    for (FieldDescription& field : fields) {
        field.row = next++;
    }
    for (ListDescription& list : lists) {
        numberRows(list.fields, list.lists, next);
    }
}

} // namespace

CodeDescription describe(const CodeLayout& layout, FieldId firstRow) {
    CodeDescription code{layout.logCode, layout.minimumLength, layout.exactLength,
                         copyOf(layout.condition)};
    code.fields = describeFields(layout.fields);
    code.lists = describe(layout.lists);
    for (const SubpacketLayout& subpacket : layout.subpackets) {
        code.subpackets.push_back(
            {subpacket.id, describeFields(subpacket.fields), describe(subpacket.lists)});
    }
    code.listPart = layout.listPart;
    code.note = layout.note;
    code.name = layout.name;
    FieldId next = firstRow;
    numberRows(code.fields, code.lists, next);
    for (SubpacketDescription& subpacket : code.subpackets) {
        numberRows(subpacket.fields, subpacket.lists, next);
    }
    return code;
}

RecordDescription describe(const RecordLayout& layout, FieldId firstRow) {
    RecordDescription description;
    for (const CodeLayout& code : layout.codes) {
        description.push_back(describe(code, firstRow));
        firstRow += static_cast<FieldId>(rowCount(code));
    }
    return description;
}

} // namespace pallax
