#include "LogGenerator/Common/SimInfo.h"

#include "LogGenerator/Common/LogCode_0xFF000020.h"
#include "LogGenerator/Records/Description.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

constexpr auto kLogCodes = std::to_array<LogCode>({kSimFilesLogCode});

struct SimFile {
    std::string_view propertyListKey;
    std::string_view key;
};

constexpr auto kSimFiles = std::to_array<SimFile>({
    {"kSimFile_ICCID", "EF-ICCID"},
    {"kSimFile_MSISDN", "EF-MSISDN"},
    {"kSimFile_MBDN", "EF-3GPP MAIL BOX DIALING NUMBER"},
    {"kSimFile_HPPLMN", "EF-HPPLMN SEARCH PERIOD"},
    {"kSimFile_LOCI", "EF-LOCI"},
    {"kSimFile_PSLOCI", "EF-GPRS/PS-LOCI"},
    {"kSimFile_ACC", "EF-ACCESS CONTROL CLASS"},
    {"kSimFile_AD", "EF-ADMINISTRATIVE DATA"},
    {"kSimFile_FPLMN", "EF-FPLMN"},
    {"kSimFile_AHPLMN", "EF-ACTING HPLMN"},
    {"kSimFile_RATMODE", "EF-RAT MODE"},
    {"kSimFile_PNN", "EF-PLMN NETWORK NAME"},
    {"kSimFile_OPL", "EF-OPERATOR PLMN LIST"},
    {"kSimFile_OPLMNAcT", "EF-OPLMNAcT"},
});
static_assert(kSimFiles.size() == 14);

} // namespace

std::span<const LogCode> SimInfo::getLogCodeArray() const {
    return kLogCodes;
}

void SimInfo::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(LogPriority::Warning, "SimInfo");
    if (logCode != kSimFilesLogCode) {
        return;
    }
    const LogCode_0xFF000020 files(record);
    for (const SimFile& simFile : kSimFiles) {
        if (const PropertyList* content = files.file(simFile.propertyListKey)) {
            show(simFile.key, *content);
        }
    }
}

RecordDescription SimInfo::describe() const {
    CodeDescription code{kSimFilesLogCode};
    code.listPart = {.kind = ListPartDescription::Kind::Keys,
                     .words = "the dictionary of SIM files; values of any type, as they come"};
    for (const SimFile& simFile : kSimFiles) {
        FieldDescription field{std::string(simFile.key)};
        field.listKey = simFile.propertyListKey;
        code.fields.push_back(std::move(field));
    }
    return {std::move(code)};
}

} // namespace pallax
