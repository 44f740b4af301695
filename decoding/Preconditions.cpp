#include "decoding/Preconditions.h"

#include "text/Format.h"

#include <algorithm>
#include <unistd.h>

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

std::optional<std::string> recordingAmong(std::span<const std::string> recordings,
                                          const std::optional<FileIdentity>& file) {
    for (const std::string& recording : recordings) {
        const bool isInput = recording == "-";
        if (file && file == (isInput ? regularFile(STDIN_FILENO) : regularFile(recording))) {
            return isInput ? "of standard input" : recording;
        }
    }
    return std::nullopt;
}

std::optional<std::string> outputIntoRecording(std::span<const std::string> recordings) {
    const auto recording = recordingAmong(recordings, regularFile(STDOUT_FILENO));
    return recording ? std::optional(formatText("Standard output would go into the recording %@.",
                                                {*recording}))
                     : std::nullopt;
}

} // namespace pallax
