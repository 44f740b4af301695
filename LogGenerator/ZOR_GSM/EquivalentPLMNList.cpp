#include "LogGenerator/ZOR_GSM/EquivalentPLMNList.h"

#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr LogCode kEquivalentPLMNLogCode = 0x7150;
constexpr auto kLogCodes = std::to_array<LogCode>({kEquivalentPLMNLogCode});

constexpr std::size_t kMinimumLength = 17;
constexpr std::size_t kCountOffset = 16;
constexpr EntryList::Layout kEntries{.start = 17, .stride = 3, .bytesRead = 6};

constexpr std::string_view kCountryCodeKey = "Mobile Country Code";
constexpr std::string_view kNetworkCodeKey = "Mobile Network Code";

/// Three digits, every second byte from `at` on.
PropertyList codeAt(const LogRecord& entry, std::size_t at) {
    const int code = entry.u8(at) * 100 + entry.u8(at + 2) * 10 + entry.u8(at + 4);
    return DisplayNumber(std::int64_t{code}, kDecimal);
}

PropertyList networkOf(const LogRecord& entry) {
    Dictionary network;
    network.setFixed(kCountryCodeKey, codeAt(entry, 0));
    network.setFixed(kNetworkCodeKey, codeAt(entry, 1));
    return network;
}

} // namespace

std::span<const LogCode> EquivalentPLMNList::getLogCodeArray() const {
    return kLogCodes;
}

void EquivalentPLMNList::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Equivalent PLMN List");
    if (logCode != kEquivalentPLMNLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kMinimumLength)) {
        return;
    }
    clearList();
    const EntryList entries(record, kEntries, record.u8(kCountOffset));
    if (entries.count() != 0) {
        replaceList(
            entries.map([](const LogRecord& entry, std::size_t) { return networkOf(entry); }));
    }
}

bool EquivalentPLMNList::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kEquivalentPLMNLogCode && record.has(kMinimumLength);
}

RecordDescription EquivalentPLMNList::describe() const {
    const auto digits = [](std::string_view key, std::size_t first) {
        return describeComputed(key, kDecimal, "digits",
                                "100 x the first byte + 10 x the second + the third",
                                {{first}, {first + 2}, {first + 4}});
    };
    ListDescription list = describeList("", kEntries, u8At(kCountOffset), {});
    list.fields = {digits(kCountryCodeKey, 0), digits(kNetworkCodeKey, 1)};
    CodeDescription code{kEquivalentPLMNLogCode, kMinimumLength};
    code.lists = {std::move(list)};
    code.note = "Neighbouring entries overlap by three bytes: of an entry 6 bytes are read.";
    return {std::move(code)};
}

} // namespace pallax
