#pragma once

#include <string>
#include <vector>

namespace pallax::doubles {

/// The files of the source tree with one of these extensions (".h"), as paths from its root,
/// sorted. What is built and what is hidden are left out.
std::vector<std::string> sourceFiles(const std::vector<std::string>& extensions);

/// The text of a file of the source tree.
std::string sourceText(const std::string& path);

/// The folder that a path from the root names: "" for a file of the root.
std::string folderOf(const std::string& path);

} // namespace pallax::doubles
