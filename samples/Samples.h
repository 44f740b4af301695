#pragma once

#include "samples/Sample.h"

#include <optional>
#include <span>
#include <string>

namespace pallax {

/// Every sample recording of the repository.
std::span<const SampleRecording> samples();

/// Writes the sample to `path`; returns an error sentence on failure.
std::optional<std::string> writeSample(const SampleRecording& sample, const std::string& path);

} // namespace pallax
