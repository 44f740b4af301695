#include "LogGenerator/LTE/ReselectionCandidatesList.h"

#include "LogGenerator/LTE/SharedLTERecords.h"
#include "LogGenerator/Records/Description.h"
#include "LogGenerator/Records/EntryList.h"
#include "platform/SystemLog.h"

#include <array>

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kReselectionLogCode});

constexpr std::size_t kCountOffset = 19;
constexpr std::size_t kHeadLength = 4;
constexpr std::size_t kTechnologyInEntry = 2;
constexpr EntryList::Layout kCandidates{
    .start = kReselectionLength, .stride = 4, .bytesRead = kHeadLength};

constexpr auto kHeadFields = std::to_array<Field>({
    {"Candidate Priority", u16At(0), Conversion::number()},
});
constexpr auto kLteFields = std::to_array<Field>({
    {"E ARFCN", u16At(4), Conversion::number()},
    {"Cell ID", bitsAt(6, 7, 9), Conversion::number()},
});
constexpr auto kUtranFields = std::to_array<Field>({
    {"U ARFCN", u16At(4), Conversion::number()},
    {"PSC", u16At(6), Conversion::number()},
});
constexpr auto kGeranFields = std::to_array<Field>({
    {"ARFCN", u16At(4), Conversion::number()},
    {"Band", u8At(6), Conversion::number()},
    {"BSIC ID", u8At(7), Conversion::number()},
});
constexpr auto kCdmaFields = std::to_array<Field>({
    {"Band", u8At(4), Conversion::number()},
    {"Channel", u16At(8), Conversion::number()},
    {"Pilot", u16At(10), Conversion::number()},
});

/// What an entry of one technology holds behind its head.
struct CandidateTechnology {
    std::string_view label;
    std::span<const Field> fields;
    std::size_t bytesRead; ///< from the entry's start to behind the last byte read of it
};
constexpr auto kTechnologies = std::to_array<CandidateTechnology>({
    {"LTE", kLteFields, 8},
    {"UTRAN", kUtranFields, 8},
    {"GERAN", kGeranFields, 8},
    {"CDMA1XRTT", kCdmaFields, 12},
    {"CDMAHRPD", kCdmaFields, 12},
});
static_assert(kTechnologies.size() == 5);
constexpr std::string_view kTechnologyKey = "Candidate RAT Type";
constexpr std::string_view kOtherTechnology = "??";

CandidateTechnology technologyOf(const LogRecord& entry) {
    const std::size_t technology = entry.u16(kTechnologyInEntry);
    return technology < kTechnologies.size()
               ? kTechnologies[technology]
               : CandidateTechnology{kOtherTechnology, {}, kHeadLength};
}

PropertyList candidateOf(const LogRecord& entry, const CandidateTechnology& technology) {
    Dictionary candidate = entryOf(kHeadFields, entry);
    candidate.setFixed(kTechnologyKey, Text::fixed(technology.label));
    showFields(candidate, technology.fields, entry);
    return candidate;
}

/// Up to the first candidate of which a byte that would be read lies outside.
Array candidatesOf(const EntryList& entries) {
    const std::size_t heads = entries.wholeCount();
    Array candidates;
    for (std::size_t index = 0; index < heads; ++index) {
        const LogRecord entry = entries.at(index);
        const CandidateTechnology technology = technologyOf(entry);
        if (!entry.has(technology.bytesRead)) {
            break;
        }
        candidates.push_back(candidateOf(entry, technology));
    }
    return candidates;
}

} // namespace

std::span<const LogCode> ReselectionCandidatesList::getLogCodeArray() const {
    return kLogCodes;
}

void ReselectionCandidatesList::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "Reselection Candidates List");
    if (logCode != kReselectionLogCode) {
        return logUnknown(logCode);
    }
    if (!record.has(kReselectionLength)) {
        return;
    }
    clearList();
    const EntryList entries(record, kCandidates, record.u16(kCountOffset));
    if (entries.count() != 0) {
        replaceList(candidatesOf(entries));
    }
}

bool ReselectionCandidatesList::replacesShown(const LogRecord& record, LogCode logCode) const {
    return logCode == kReselectionLogCode && record.has(kReselectionLength);
}

namespace {

constexpr auto kTechnologyLabels = [] {
    std::array<std::string_view, kTechnologies.size()> labels{};
    for (std::size_t index = 0; index < labels.size(); ++index) {
        labels[index] = kTechnologies[index].label;
    }
    return labels;
}();

} // namespace

RecordDescription ReselectionCandidatesList::describe() const {
    const Position technology = u16At(kTechnologyInEntry);
    ListDescription list = describeList("", kCandidates, u16At(kCountOffset), kHeadFields);
    list.fields.push_back({std::string(kTechnologyKey), technology,
                           Conversion::label(kTechnologyLabels, kOtherTechnology).shownAs()});
    std::int64_t number = 0;
    for (const CandidateTechnology& each : kTechnologies) {
        for (FieldDescription field : describeFields(each.fields)) {
            field.condition = Condition{technology, number, number};
            list.fields.push_back(std::move(field));
        }
        ++number;
    }
    CodeDescription code{kReselectionLogCode, kReselectionLength};
    code.lists = {std::move(list)};
    code.note =
        "Neighbouring entries overlap: of an entry 8 bytes are read, 12 with RAT type 3 or 4, and "
        "4 "
        "with a type beyond, so that its fields from byte 4 on are also the beginning of the "
        "entries after it.";
    return {std::move(code)};
}

} // namespace pallax
