#include "LogGenerator/Common/PDPContextList.h"

#include "plist/PropertyListCodec.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kContextFields = std::to_array<Field>({Field{}.personal()});

std::optional<PropertyList> parseContexts(const LogRecord& record) {
    PropertyListResult contexts = parsePropertyList(record.payload());
    return contexts ? std::optional(std::move(contexts).value()) : std::nullopt;
}

constexpr ListPart kContexts{
    .kind = ListPart::Kind::Elements,
    .parse = parseContexts,
    .words = "the array of contexts, as the telephony service describes them",
};

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kPDPContextsLogCode,
    .name = "Contexts of packet data",
    .fields = kContextFields,
    .listPart = &kContexts,
}});

constexpr RecordLayout kLayout{
    .section = "PDP Context Info",
    .logLine = "PDPContextList",
    .kind = SectionKind::List,
    .meaning = "The packet data contexts, each as the telephony service describes it.",
    .codes = kCodes,
    .readsOtherCodes = true,
};

} // namespace

PDPContextList::PDPContextList() : LayoutRecord(kLayout) {}

} // namespace pallax
