#include "LogGenerator/Common/PDPContextList.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"
#include "plist/PropertyListCodec.h"

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kPDPContextsLogCode});

} // namespace

std::span<const LogCode> PDPContextList::getLogCodeArray() const {
    return kLogCodes;
}

void PDPContextList::updateWithData(const LogRecord& record, LogCode /*logCode*/) {
    systemLog(LogPriority::Warning, "PDPContextList");
    const PropertyListResult parsed = parsePropertyList(record.payload());
    const ArrayRef contexts = parsed ? parsed->array() : nullptr;
    if (contexts != nullptr) {
        replaceList(*contexts);
    }
}

RecordDescription PDPContextList::describe() const {
    CodeDescription code{kPDPContextsLogCode};
    code.listPart = {.kind = ListPartDescription::Kind::Elements,
                     .words = "the array of contexts, as the telephony service describes them"};
    return {std::move(code)};
}

} // namespace pallax
