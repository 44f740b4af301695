#pragma once

#include "platform/Resources.h"

namespace pallax {

/// The resources as files of one folder.
class DirectoryResources final : public Resources {
public:
    explicit DirectoryResources(std::string folder) : _folder(std::move(folder)) {}

    /// Where this program's resources lie: `$PALLAX_RESOURCES`, else where `folderFor` says.
    static std::string programFolder();
    /// `share/pallax` in the program's own folder, as a build folder has it, where there is one;
    /// else `../share/pallax` seen from that folder, as an installation has it.
    static std::string folderFor(const std::string& program);

    std::optional<PropertyList> propertyList(std::string_view name) const override;
    std::vector<std::string> propertyListPaths() const override;

private:
    std::string _folder;
};

} // namespace pallax
