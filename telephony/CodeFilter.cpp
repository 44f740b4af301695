#include "telephony/CodeFilter.h"

#include "platform/PropertyList.h"

#include <string_view>

namespace pallax {

namespace {

constexpr std::uint32_t kExtended = 0xFF0000;

void addCodes(std::unordered_set<std::uint32_t>& codes, const Dictionary& command,
              std::string_view key, std::uint32_t mark) {
    const PropertyList* value = command.find(key);
    const ArrayRef list = value != nullptr ? value->array() : nullptr;
    if (list == nullptr) {
        return;
    }
    for (const PropertyList& element : *list) {
        if (const auto code = element.int32()) {
            codes.insert(static_cast<std::uint32_t>(*code) | mark);
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
    addCodes(filter._codes, command, "SetHxExtraCodes", kExtended);
    return filter;
}

bool CodeFilter::wants(Bytes packet) const {
    const auto code = _everything ? std::nullopt : effectiveCodeOf(packet);
    return !code || _codes.contains(*code);
}

std::optional<std::uint32_t> effectiveCodeOf(Bytes packet) {
    constexpr std::uint8_t kPrefixMark = 0x81;
    constexpr std::size_t kPrefixSize = 2;
    constexpr std::size_t kCodeAt = 3;
    constexpr std::uint8_t kExtendedType = 0xFF;
    constexpr unsigned kBitsPerByte = 8;
    if (packet.size() >= kPrefixSize && packet.front() == kPrefixMark) {
        packet = packet.subspan(kPrefixSize);
    }
    if (packet.size() < kCodeAt + 2) {
        return std::nullopt;
    }
    const std::uint32_t high = packet[kCodeAt + 1];
    const std::uint32_t code = packet[kCodeAt] | (high << kBitsPerByte);
    return packet.front() == kExtendedType ? kExtended | code : code;
}

} // namespace pallax
