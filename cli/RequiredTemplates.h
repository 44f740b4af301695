#pragma once

#include "host/DirectoryResources.h"

#include <stdexcept>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// A display template cannot be loaded; the text is the sentence. No record is at fault: whoever
/// drops a packet whose record throws lets this one pass.
class TemplateFailure : public std::runtime_error {
public:
    using std::runtime_error::runtime_error;
};

/// The display templates as files of one folder. A generator that finds no template shows nothing
/// and goes on, so the program would never notice: this throws TemplateFailure when a template
/// that is asked for cannot be had. Templates that nobody asks for may be missing.
class RequiredTemplates final : public Resources {
public:
    explicit RequiredTemplates(std::string folder) : _files(std::move(folder)) {}

    std::optional<PropertyList> propertyList(std::string_view name) const override;
    /// At least one of them is the template of UTRAN, which is what they are asked for.
    std::vector<std::string> propertyListPaths() const override;

private:
    DirectoryResources _files;
};

} // namespace pallax
