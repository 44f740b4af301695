#include "LogGenerator/Technologies/Technologies.h"

#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "LogGenerator/LTE/LTELogGenerator.h"
#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "LogGenerator/ZOR_GSM/ZOR_GSMLogGenerator.h"
#include "platform/TelephonyConstants.h"

#include <array>

namespace pallax {

std::span<const Technology> technologies() {
    static constexpr auto kTechnologies = std::to_array<Technology>({
        {kHXLogChannelTechnology_IFX, GSMLogGenerator::generator},
        {kHXLogChannelTechnology_Zorell_GSM, ZOR_GSMLogGenerator::generator},
        {kHXLogChannelTechnology_Zorell_CDMA, C2KLogGenerator::generator},
        {kHXLogChannelTechnology_Zorell_LTE, LTELogGenerator::generator},
        {kHXLogChannelTechnology_Zorell_UTRAN2, UTRANLogGenerator::generator},
    });
    return kTechnologies;
}

bool isTemplateOfUtran(std::string_view path) {
    return UTRANLogGenerator::isTemplate(path);
}

} // namespace pallax
