#include "LogGenerator/LTE/ReselectionCandidatesList.h"

#include "LogGenerator/LTE/SharedLTERecords.h"

#include <array>

namespace pallax {

namespace {

constexpr std::size_t kHeadLength = 4;
constexpr Position kTechnology = u16At(2);
constexpr auto kTechnologies =
    std::to_array<std::string_view>({"LTE", "UTRAN", "GERAN", "CDMA1XRTT", "CDMAHRPD"});
static_assert(kTechnologies.size() == 5);

constexpr Condition kIsLte{kTechnology, 0, 0};
constexpr Condition kIsUtran{kTechnology, 1, 1};
constexpr Condition kIsGeran{kTechnology, 2, 2};
constexpr Condition kIsOneX{kTechnology, 3, 3};
constexpr Condition kIsHrpd{kTechnology, 4, 4};

constexpr Field kCdmaBand{"Band", u8At(4), Conversion::number()};
constexpr Field kCdmaChannel{"Channel", u16At(8), Conversion::number(),
                             "Channel number of a CDMA candidate."};
constexpr Field kCdmaPilot{"Pilot", u16At(10), Conversion::number(),
                           "PN offset of the pilot of a CDMA candidate."};

/// The head, then the fields of each technology.
constexpr auto kCandidateFields = std::to_array<Field>({
    {"Candidate Priority", u16At(0), Conversion::number(),
     "Reselection priority of the candidate."},
    Field{"Candidate RAT Type", kTechnology, Conversion::label(kTechnologies, "??"),
          "Radio access technology of the candidate."}
        .identifying(),
    Field{"E ARFCN", u16At(4), Conversion::number(), "EARFCN of an LTE candidate."}
        .when(kIsLte)
        .identifying(),
    Field{"Cell ID", bitsAt(6, 7, 9), Conversion::number(),
          "Physical cell identity of an LTE candidate."}
        .when(kIsLte)
        .identifying(),
    Field{"U ARFCN", u16At(4), Conversion::number(), "UARFCN of a UTRAN candidate."}
        .when(kIsUtran)
        .identifying(),
    Field{"PSC", u16At(6), Conversion::number(), "Primary scrambling code of a UTRAN candidate."}
        .when(kIsUtran)
        .identifying(),
    Field{"ARFCN", u16At(4), Conversion::number(), "ARFCN of a GSM candidate."}
        .when(kIsGeran)
        .identifying(),
    Field{"Band", u8At(6), Conversion::number(),
          "Band of a GSM candidate, band class of a CDMA one."}
        .when(kIsGeran)
        .identifying(),
    Field{"BSIC ID", u8At(7), Conversion::number(),
          "Base station identity code of a GSM candidate."}
        .when(kIsGeran)
        .identifying(),
    kCdmaBand.when(kIsOneX).identifying(),
    kCdmaChannel.when(kIsOneX).identifying(),
    kCdmaPilot.when(kIsOneX).identifying(),
    kCdmaBand.when(kIsHrpd).identifying(),
    kCdmaChannel.when(kIsHrpd).identifying(),
    kCdmaPilot.when(kIsHrpd).identifying(),
});

constexpr auto kLists = std::to_array<ListLayout>({{
    .entries = {{.start = kReselectionLength, .stride = 4, .bytesRead = kHeadLength}},
    .count = u16At(19),
    .fields = kCandidateFields,
}});

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kReselectionLogCode,
    .minimumLength = kReselectionLength,
    .lists = kLists,
    .note = "Neighbouring entries overlap: of an entry 8 bytes are read, 12 with RAT type 3 or 4, "
            "and 4 with a type beyond, so that its fields from byte 4 on are also the beginning of "
            "the entries after it.",
}});

constexpr RecordLayout kLayout{
    .section = "Reselection Candidates List",
    .logLine = "Reselection Candidates List",
    .kind = SectionKind::List,
    .meaning = "The cells, of any technology, that the phone may reselect to in idle mode.",
    .codes = kCodes,
};

} // namespace

ReselectionCandidatesList::ReselectionCandidatesList() : LayoutRecord(kLayout) {}

} // namespace pallax
