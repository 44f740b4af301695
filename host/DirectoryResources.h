#pragma once

#include "host/HostError.h"
#include "platform/Resources.h"
#include "text/Result.h"

namespace pallax {

/// The resources (display templates) as files of one folder.
class DirectoryResources final : public Resources {
public:
    explicit DirectoryResources(std::string folder) : _folder(std::move(folder)) {}

    /// The folder of this program's resources: `$PALLAX_RESOURCES`, else the result of `folderFor`.
    static std::string programFolder();
    /// `share/pallax` in the program's own folder if it exists (a build folder), otherwise
    /// `../share/pallax` relative to that folder (an installation).
    static std::string folderFor(const std::string& program);

    const std::string& folder() const { return _folder; }

    /// The resource with this name, a dictionary; an error names the file and the reason.
    Result<PropertyList, HostError> load(std::string_view name) const;
    /// Like `propertyListPaths`, but a folder that cannot be read completely is an error.
    Result<std::vector<std::string>, HostError> list() const;

    std::optional<PropertyList> propertyList(std::string_view name) const override;
    std::vector<std::string> propertyListPaths() const override;

private:
    std::string _folder;
};

} // namespace pallax
