#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kFields = std::to_array<Field>({
    {"Version", u8At(13), Conversion::number(), "Version of the log record's layout."},
    {"Serving EARFCN", u16At(15), Conversion::number(), "EARFCN of the serving cell's downlink."},
    {"Serving Cell ID", u16At(17), Conversion::number(),
     "Physical cell identity of the serving cell."},
});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kReselectionLogCode,
    .name = "Candidates of the idle-mode reselection",
    .minimumLength = kReselectionLength,
    .fields = kFields,
}});

constexpr RecordLayout kLayout{
    .section = "Reselection Candidates",
    .logLine = "Reselection Candidates",
    .meaning = "The serving cell from which the phone may reselect.",
    .codes = kCodes,
};

} // namespace

ReselectionCandidatesMisc::ReselectionCandidatesMisc() : LayoutRecord(kLayout) {}

} // namespace pallax
