#pragma once

#include "LogGenerator/LogGenerator.h"
#include "host/FileIdentity.h"
#include "host/Recording.h"

#include <optional>
#include <span>
#include <string>
#include <string_view>

/// Checks before a recording is read; each returns a sentence if it fails.
namespace pallax {

std::string noGeneratorSentence(std::string_view recording, std::string_view technology);

/// Nothing if the recording's technology is one of `technologies`, or its link type is unknown.
std::optional<std::string> missingGenerator(const Recording& recording,
                                            std::span<const Technology> technologies);

/// The one of `recordings` that is the same file ("-" is standard input), as the user named it.
std::optional<std::string> recordingAmong(std::span<const std::string> recordings,
                                          const std::optional<FileIdentity>& file);

/// Nothing when standard output is none of `recordings`.
std::optional<std::string> outputIntoRecording(std::span<const std::string> recordings);

} // namespace pallax
