#pragma once

#include "platform/Resources.h"

namespace pallax {

/// The resources as files of one folder.
class DirectoryResources final : public Resources {
public:
    explicit DirectoryResources(std::string folder) : _folder(std::move(folder)) {}

    /// Where this program's resources lie: `$PALLAX_RESOURCES`, else `../share/pallax` seen from
    /// the program, else, for a program that runs from its build folder, the source tree's.
    static std::string programFolder();

    std::optional<PropertyList> propertyList(std::string_view name) const override;
    std::vector<std::string> propertyListPaths() const override;

private:
    std::string _folder;
};

} // namespace pallax
