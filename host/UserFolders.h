#pragma once

#include <filesystem>
#include <optional>
#include <vector>

/// Where users and packages keep files, by the rules of the XDG base directories.
namespace pallax {

/// $XDG_CONFIG_HOME, or ~/.config if that is not an absolute path; nothing without a home.
std::optional<std::filesystem::path> configurationFolder();

/// $XDG_DATA_HOME, or ~/.local/share if that is not an absolute path; nothing without a home.
std::optional<std::filesystem::path> dataFolder();

/// $XDG_DATA_DIRS, or /usr/local/share and /usr/share: where packages install data.
std::vector<std::filesystem::path> dataFolders();

} // namespace pallax
