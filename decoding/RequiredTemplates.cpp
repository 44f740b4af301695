#include "decoding/RequiredTemplates.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "text/Format.h"

#include <algorithm>

namespace pallax {

std::optional<PropertyList> RequiredTemplates::propertyList(std::string_view name) const {
    auto loaded = _files.load(name);
    if (!loaded) {
        throw TemplateFailure(loaded.error().sentence);
    }
    return std::move(loaded).value();
}

std::vector<std::string> RequiredTemplates::propertyListPaths() const {
    auto paths = _files.list();
    if (!paths) {
        throw TemplateFailure(paths.error().sentence);
    }
    if (std::none_of(paths->begin(), paths->end(), isTemplateOfUtran)) {
        throw TemplateFailure(
            formatText("There is no display template for UTRAN in %@.", {_files.folder()}));
    }
    return std::move(paths).value();
}

} // namespace pallax
