#pragma once

#include "host/DirectoryResources.h"

#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A display template cannot be loaded; the text is one sentence for the user. It ends the program
/// even if packets whose records throw are dropped.
class TemplateFailure : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// The display templates as files of one folder. A generator without its template logs that and
/// shows nothing, and the program would not notice; so this throws TemplateFailure when a requested
/// template cannot be loaded. Other templates may be missing.
class RequiredTemplates final : public Resources {
public:
    explicit RequiredTemplates(std::string folder) : _files(std::move(folder)) {}

    std::optional<PropertyList> propertyList(std::string_view name) const override;
    /// Throws unless one of them is the template of UTRAN, whose generator calls this.
    std::vector<std::string> propertyListPaths() const override;

private:
    DirectoryResources _files;
};

} // namespace pallax
