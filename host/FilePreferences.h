#pragma once

#include "platform/Preferences.h"

#include <map>
#include <string>

namespace pallax {

/// Preferences as one XML property-list file per domain.
class FilePreferences final : public Preferences {
public:
    explicit FilePreferences(std::string folder) : _folder(std::move(folder)) {}

    /// `$XDG_CONFIG_HOME/pallax/preferences`, or the same below `~/.config`.
    static std::string userFolder();

    void setValue(std::string_view key, const PropertyList& value,
                  std::string_view domain) override;
    /// Writes the values set since the last call to the domain's file, which keeps its other
    /// values. False, leaving the file unchanged, if the current file cannot be read.
    bool synchronize(std::string_view domain) override;
    /// Does nothing: on Linux there are no listeners; readers read the file.
    void postChangedNotice(std::string_view domain, std::string_view key) override;

private:
    std::string fileOf(std::string_view domain) const;

    std::string _folder;
    std::map<std::string, Dictionary, std::less<>> _changes; // by domain, not yet written
};

} // namespace pallax
