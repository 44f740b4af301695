#pragma once

#include <span>
#include <string_view>

namespace pallax {

/// The technology of a recording, identified by its link type; the identifier is the telephony
/// service's answer to GetTechnology.
struct RecordedTechnology {
    int linkType;                 ///< 147 … 151
    std::string_view identifier;  ///< "Zorell_GSM"
    std::string_view commandName; ///< "gsm", the name on the command line
};

/// The five known technologies, by link type.
std::span<const RecordedTechnology> recordedTechnologies();
const RecordedTechnology* technologyOfLinkType(int linkType);
const RecordedTechnology* technologyOfCommandName(std::string_view name);
const RecordedTechnology* technologyOfIdentifier(std::string_view identifier);

} // namespace pallax
