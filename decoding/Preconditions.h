#pragma once

#include "LogGenerator/LogGenerator.h"
#include "host/FileIdentity.h"
#include "host/Recording.h"

#include <optional>
#include <span>
#include <string>
#include <string_view>

/// What must hold before a recording is worth reading; each a sentence when it does not.
namespace pallax {

std::string noGeneratorSentence(std::string_view recording, std::string_view technology);

/// Nothing when one of `technologies` is that of the recording, or when its link type tells none.
std::optional<std::string> missingGenerator(const Recording& recording,
                                            std::span<const Technology> technologies);

/// The one of `recordings` that is the same file ("-" is standard input), as the user named it.
std::optional<std::string> recordingAmong(std::span<const std::string> recordings,
                                          const std::optional<FileIdentity>& file);

/// Nothing when standard output is none of `recordings`.
std::optional<std::string> outputIntoRecording(std::span<const std::string> recordings);

} // namespace pallax
