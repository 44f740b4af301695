#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number()},
    {"Serving EARFCN", u16At(15), Conversion::number()},
    {"Serving Cell ID", u16At(17), Conversion::number()},
});

constexpr auto kGroups =
    std::to_array<FieldGroup>({{kReselectionLogCode, kReselectionLength, kFields}});
constexpr auto kLogCodes = logCodesOf(kGroups);

} // namespace

std::span<const LogCode> ReselectionCandidatesMisc::getLogCodeArray() const {
    return kLogCodes;
}

void ReselectionCandidatesMisc::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Reselection Candidates");
    showGroup(kGroups, record, logCode);
}

bool ReselectionCandidatesMisc::replacesShown(const LogRecord& record, LogCode logCode) const {
    return isOfGroup(kGroups, record, logCode);
}

RecordDescription ReselectionCandidatesMisc::describe() const {
    return describeGroups(kGroups);
}

} // namespace pallax
