#include "LogGenerator/Records/Description.h"

namespace pallax {

Extent extentOf(const Position& position, Extent::Origin origin) {
    constexpr unsigned kByteBits = 8;
    return {position.byte, (position.bit + position.width + kByteBits - 1) / kByteBits, origin};
}

FieldDescription describeComputed(std::string_view key, const NumberFormat& format,
                                  std::string_view computation, std::string_view formula,
                                  std::vector<Extent> read) {
    FieldDescription field{std::string(key)};
    field.shownAs.format = &format;
    field.formula = formula;
    field.computation = computation;
    field.read = std::move(read);
    return field;
}

FieldDescription describeField(const Field& field) {
    return {std::string(field.key), field.position, field.conversion.shownAs()};
}

std::vector<FieldDescription> describeFields(std::span<const Field> fields) {
    std::vector<FieldDescription> descriptions;
    for (const Field& field : fields) {
        descriptions.push_back(describeField(field));
    }
    return descriptions;
}

RecordDescription describeGroups(std::span<const FieldGroup> groups) {
    RecordDescription description;
    for (const FieldGroup& group : groups) {
        CodeDescription code{group.logCode, group.minimumLength};
        code.fields = describeFields(group.fields);
        description.push_back(std::move(code));
    }
    return description;
}

ListDescription describeList(std::string_view key, const EntryList::Layout& layout,
                             const Position& count, std::span<const Field> fields) {
    ListDescription list{std::string(key), {layout}, count};
    list.fields = describeFields(fields);
    return list;
}

} // namespace pallax
