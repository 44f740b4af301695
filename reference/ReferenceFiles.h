#pragma once

#include "platform/Resources.h"

#include <string>
#include <vector>

namespace pallax {

/// A file that is made of the descriptions.
struct ReferenceFile {
    std::string path; ///< in the source tree: "docs/records/lte.md"
    std::string text;
};

/// All of them. `resources` holds the templates; `program` is the
/// part of the dissector that is written by hand (dissector.lua beside this file).
std::vector<ReferenceFile> referenceFiles(const Resources& resources, const std::string& program);

} // namespace pallax
