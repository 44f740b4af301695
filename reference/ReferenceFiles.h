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

/// The part of the dissector that is written by hand: the files of the folder reference/dissector
/// of a source tree, in their order. Throws std::runtime_error where one cannot be read.
std::string dissectorProgram(const std::string& tree);

/// All of them. `resources` holds the templates; `program` is what `dissectorProgram` gives.
std::vector<ReferenceFile> referenceFiles(const Resources& resources, const std::string& program);

} // namespace pallax
