#pragma once

#include "fields/Standing.h"
#include "knowledge/Networks.h"
#include "knowledge/Quality.h"
#include "timeline/LeafField.h"
#include "timeline/Reading.h"

#include <optional>
#include <string>
#include <vector>

namespace pallax {

/// What can be said about one value of the display.
struct ValueFacts {
    std::string text; ///< "-92.25 dBm"; empty if there is no value now
    Standing standing = Standing::Value;
    std::optional<Grade> grade; ///< nothing if the profile does not judge the field
    std::string borders;        ///< "android: poor -115, fair -105, good -95, excellent -85"
    std::string meaning;        ///< a sentence
    std::vector<std::string> knowledge; ///< "band 3", "downlink 1870.0 MHz"
    std::string range; ///< "-180 to -52.25"; empty if the layout does not limit the number
    std::vector<std::string> origin; ///< "raw 191 x 0.25 - 140", "log code 0xB17F"
};

/// `value` and `reading` may be null. Texts of the modem stay as they are.
ValueFacts factsOf(const CurrentValues& values, const FieldInfo& field, const LeafValue* value,
                   const Reading* reading, const NetworkNames& names,
                   const QualityProfile& profile);

Standing standingOf(const FieldInfo& field, const FieldValue& value);

/// What is known about a value beside the modem: the band of a channel, the name of a network, the
/// parts of an identity.
std::vector<std::string> knowledgeOf(const CurrentValues& values, const FieldInfo& field,
                                     const FieldValue& value, const NetworkNames& names);

/// The shortest text that reads back as the same number.
std::string shortNumber(double number);

} // namespace pallax
