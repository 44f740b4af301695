#include "LogGenerator/Common/SimInfo.h"

#include "LogGenerator/Common/LogCode_0xFF000020.h"

#include <array>

namespace pallax {

namespace {

constexpr Field simFile(std::string_view listKey, std::string_view key, std::string_view meaning) {
    Field field{.key = key, .meaning = meaning};
    field.listKey = listKey;
    return field;
}

constexpr auto kSimFiles = std::to_array<Field>({
    simFile("kSimFile_ICCID", "EF-ICCID", "Identity of the card.").personal(),
    simFile("kSimFile_MSISDN", "EF-MSISDN", "The subscriber's own number.").personal(),
    simFile("kSimFile_MBDN", "EF-3GPP MAIL BOX DIALING NUMBER", "Number of the voice mailbox.")
        .personal(),
    simFile("kSimFile_HPPLMN", "EF-HPPLMN SEARCH PERIOD",
            "How often a roaming phone looks for a network of higher priority."),
    simFile("kSimFile_LOCI", "EF-LOCI",
            "Temporary identity, location area and update status of the circuit-switched domain.")
        .personal(),
    simFile("kSimFile_PSLOCI", "EF-GPRS/PS-LOCI",
            "Temporary identity, routing area and update status of the packet-switched domain.")
        .personal(),
    // One of classes 0 to 9 follows from the IMSI; 11 to 15 are for users with special duties.
    simFile("kSimFile_ACC", "EF-ACCESS CONTROL CLASS", "Access control classes of the subscriber.")
        .personal(),
    simFile("kSimFile_AD", "EF-ADMINISTRATIVE DATA",
            "Mode of operation of the card, and the length of the network code in its IMSI."),
    simFile("kSimFile_FPLMN", "EF-FPLMN", "Forbidden networks."),
    simFile("kSimFile_AHPLMN", "EF-ACTING HPLMN", "Network that counts as the home network."),
    simFile("kSimFile_RATMODE", "EF-RAT MODE", "Radio access technologies that the card prefers."),
    simFile("kSimFile_PNN", "EF-PLMN NETWORK NAME", "Names of networks."),
    simFile("kSimFile_OPL", "EF-OPERATOR PLMN LIST",
            "Networks and areas to which the names in EF-PNN apply."),
    simFile("kSimFile_OPLMNAcT", "EF-OPLMNAcT",
            "Networks that the operator prefers, with their access technologies."),
});
static_assert(kSimFiles.size() == 14);

std::optional<PropertyList> parseFiles(const LogRecord& record) {
    return LogCode_0xFF000020(record).files();
}

constexpr ListPart kFiles{
    .kind = ListPart::Kind::Keys,
    .parse = parseFiles,
    .words = "the dictionary of SIM files; values of any type, as they come",
};

constexpr auto kCodes = std::to_array<CodeLayout>({{
    .logCode = kSimFilesLogCode,
    .name = "SIM files",
    .fields = kSimFiles,
    .listPart = &kFiles,
}});

constexpr RecordLayout kLayout{
    .section = "SIM Info",
    .logLine = "SimInfo",
    .meaning = "Elementary files of the SIM, as read by the telephony service.",
    .codes = kCodes,
    .reportsOtherCodes = false,
};

} // namespace

SimInfo::SimInfo() : LayoutRecord(kLayout) {}

} // namespace pallax
