#include "LogGenerator/ZOR_GSM/SearcherSet.h"

#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr LogCode kSearcherLogCode = 0x417A;
constexpr auto kLogCodes = std::to_array<LogCode>({kSearcherLogCode});
constexpr std::size_t kMinimumLength = 16;

} // namespace

std::span<const LogCode> SearcherSet::getLogCodeArray() const {
    return kLogCodes;
}

Array SearcherSet::cellsOf(const LogRecord& /*record*/) const {
    return {};
}

std::size_t SearcherSet::cellCount(const LogRecord& record) {
    return record.u8(kCellCountOffset);
}

void SearcherSet::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "%s", _logLine);
    if (logCode != kSearcherLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kMinimumLength)) {
        return;
    }
    clearList();
    if (cellCount(record) != 0) {
        replaceList(cellsOf(record));
    }
}

bool SearcherSet::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kSearcherLogCode && record.has(kMinimumLength);
}

RecordDescription SearcherSet::describe() const {
    CodeDescription code{kSearcherLogCode, kMinimumLength};
    code.note = "Empties the list; none of the record's cells is shown.";
    return {std::move(code)};
}

} // namespace pallax
