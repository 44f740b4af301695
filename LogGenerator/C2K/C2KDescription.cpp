#include "LogGenerator/C2K/C2KDescription.h"

#include "LogGenerator/C2K/C2KFormats.h"
#include "LogGenerator/C2K/PilotList.h"

namespace pallax {

FieldDescription describeNumber(std::string_view name, const Position& position,
                                const NumberFormat& format, double factor, double offset) {
    return describeField({name, position, Conversion::number(format, factor, offset)});
}

FieldDescription describeLabel(std::string_view name, const Position& position,
                               const LabelTable& labels) {
    FieldDescription field{std::string(name), position};
    field.shownAs.labels = labels.labels;
    field.shownAs.beyondFormat = labels.beyond;
    return field;
}

ListDescription describePilots(std::string_view lookupName, const EntryList::Layout& layout,
                               const Position& count, const Position& name,
                               const Position& energy) {
    ListDescription list = describeList(lookupName, layout, count, {});
    list.entryName = name;
    list.ifEmpty = PilotList::kNone;
    list.fields = {describeComputed("", kSignedLevelDb, "energy", "10 x log10(raw / 512)",
                                    {extentOf(energy)})};
    return list;
}

} // namespace pallax
