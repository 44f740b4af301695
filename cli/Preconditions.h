#pragma once

#include <optional>
#include <string>
#include <string_view>

/// What must hold before a recording is worth reading; each a sentence when it does not.
namespace pallax {

/// Nothing when the display templates are where the program looks for them.
std::optional<std::string> missingTemplates();

std::string noGeneratorSentence(std::string_view recording, std::string_view technology);

} // namespace pallax
