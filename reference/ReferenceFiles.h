#pragma once

#include "platform/Resources.h"

#include <string>
#include <vector>

namespace pallax {

/// A file generated from the descriptions.
struct ReferenceFile {
    std::string path; ///< in the source tree: "docs/records/lte.md"
    std::string text;
};

/// The handwritten part of the dissector: the files of the folder reference/dissector of a source
/// tree, in their order. Throws std::runtime_error if one cannot be read.
std::string dissectorProgram(const std::string& tree);

/// All generated files. `resources` holds the templates; `program` is the result of
/// `dissectorProgram`.
std::vector<ReferenceFile> referenceFiles(const Resources& resources, const std::string& program);

} // namespace pallax
