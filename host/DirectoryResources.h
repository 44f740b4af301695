#pragma once

#include "host/HostError.h"
#include "platform/Resources.h"
#include "text/Result.h"

namespace pallax {

/// The resources, which are display templates, as files of one folder.
class DirectoryResources final : public Resources {
public:
    explicit DirectoryResources(std::string folder) : _folder(std::move(folder)) {}

    /// Where this program's resources lie: `$PALLAX_RESOURCES`, else where `folderFor` says.
    static std::string programFolder();
    /// `share/pallax` in the program's own folder, as a build folder has it, where there is one;
    /// else `../share/pallax` seen from that folder, as an installation has it.
    static std::string folderFor(const std::string& program);

    const std::string& folder() const { return _folder; }

    /// The resource of that name, a dictionary; an error names the file and the reason.
    Result<PropertyList, HostError> load(std::string_view name) const;
    /// As `propertyListPaths`, but a folder that cannot be read to its end is an error.
    Result<std::vector<std::string>, HostError> list() const;

    std::optional<PropertyList> propertyList(std::string_view name) const override;
    std::vector<std::string> propertyListPaths() const override;

private:
    std::string _folder;
};

} // namespace pallax
