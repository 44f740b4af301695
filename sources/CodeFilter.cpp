#include "sources/CodeFilter.h"

#include "LogGenerator/LogPacket.h"
#include "plist/PropertyList.h"

#include <string_view>

namespace pallax {

namespace {

void addCodes(std::unordered_set<LogCode>& codes, const Dictionary& command, std::string_view key,
              LogCode mark) {
    const PropertyList* value = command.find(key);
    const ArrayRef list = value != nullptr ? value->array() : nullptr;
    if (list == nullptr) {
        return;
    }
    for (const PropertyList& element : *list) {
        if (const auto code = element.int32()) {
            codes.insert(static_cast<LogCode>(*code) | mark);
        }
    }
}

} // namespace

std::optional<CodeFilter> CodeFilter::fromStartCommand(const Dictionary& command, bool everything) {
    const PropertyList* state = command.find("SetState");
    if (state == nullptr || state->string() != "Streaming") {
        return std::nullopt;
    }
    CodeFilter filter;
    filter._everything = everything;
    addCodes(filter._codes, command, "SetZorellLogCodes", 0);
    addCodes(filter._codes, command, "SetHxExtraCodes", kExtendedLogCodes);
    return filter;
}

bool CodeFilter::wants(Bytes packet) const {
    const auto code = _everything ? std::nullopt : effectiveCodeOf(packet);
    return !code || _codes.contains(*code);
}

std::optional<LogCode> effectiveCodeOf(Bytes packet) {
    const LogRecord record(LogPacketRecord(packet));
    return record.has(kLogCodeEnd) ? std::optional(LogPacketGetLogCode(record)) : std::nullopt;
}

} // namespace pallax
