#pragma once

#include <string>
#include <vector>

namespace pallax::doubles {

/// The files of the source tree with one of these extensions (".h"), as sorted paths from its root,
/// without build folders, hidden files, and the packages of the page.
std::vector<std::string> sourceFiles(const std::vector<std::string>& extensions);

/// The text of a file of the source tree.
std::string sourceText(const std::string& path);

/// The folder part of a path from the root; "" for a file in the root.
std::string folderOf(const std::string& path);

} // namespace pallax::doubles
