#include "platform/RecordedTechnology.h"

#include "platform/TelephonyConstants.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

// Link types reserved for private use, from USER0 on.
constexpr std::array<RecordedTechnology, 5> kTechnologies = {{
    {147, kHXLogChannelTechnology_IFX, "ifx"},
    {148, kHXLogChannelTechnology_Zorell_GSM, "gsm"},
    {149, kHXLogChannelTechnology_Zorell_CDMA, "cdma"},
    {150, kHXLogChannelTechnology_Zorell_LTE, "lte"},
    {151, kHXLogChannelTechnology_Zorell_UTRAN2, "utran"},
}};

template <class Matches>
const RecordedTechnology* firstThat(Matches matches) {
    const auto* found = std::find_if(kTechnologies.begin(), kTechnologies.end(), matches);
    return found != kTechnologies.end() ? found : nullptr;
}

} // namespace

std::span<const RecordedTechnology> recordedTechnologies() {
    return kTechnologies;
}

const RecordedTechnology* technologyOfLinkType(int linkType) {
    return firstThat([&](const RecordedTechnology& each) { return each.linkType == linkType; });
}

const RecordedTechnology* technologyOfCommandName(std::string_view name) {
    return firstThat([&](const RecordedTechnology& each) { return each.commandName == name; });
}

const RecordedTechnology* technologyOfIdentifier(std::string_view identifier) {
    return firstThat([&](const RecordedTechnology& each) { return each.identifier == identifier; });
}

} // namespace pallax
