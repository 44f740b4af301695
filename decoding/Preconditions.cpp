#include "decoding/Preconditions.h"

#include "text/Format.h"

#include <algorithm>

namespace pallax {

std::string noGeneratorSentence(std::string_view recording, std::string_view technology) {
    return formatText("%@: there is no log generator for the technology %@.",
                      {recording, technology});
}

std::optional<std::string> missingGenerator(const Recording& recording,
                                            std::span<const Technology> technologies) {
    const RecordedTechnology* recorded = recording.technology();
    if (recorded == nullptr ||
        std::any_of(technologies.begin(), technologies.end(), [recorded](const Technology& known) {
            return known.identifier == recorded->identifier;
        })) {
        return std::nullopt;
    }
    return noGeneratorSentence(recording.name(), recorded->identifier);
}

} // namespace pallax
