#include "tests/docs/SourceTree.h"

#include "tests/doubles/Files.h"

#include <algorithm>
#include <filesystem>

namespace pallax::doubles {

namespace fs = std::filesystem;

std::vector<std::string> sourceFiles(const std::vector<std::string>& extensions) {
    const fs::path root = PALLAX_SOURCE_DIR;
    std::vector<std::string> files;
    for (auto entry = fs::recursive_directory_iterator(root);
         entry != fs::recursive_directory_iterator(); ++entry) {
        const std::string name = entry->path().filename().string();
        const bool isBuilt = (entry.depth() == 0 && name == "build") || name == "node_modules";
        if (entry->is_directory() && (isBuilt || name.starts_with("."))) {
            entry.disable_recursion_pending();
        } else if (std::find(extensions.begin(), extensions.end(), entry->path().extension()) !=
                   extensions.end()) {
            files.push_back(fs::relative(entry->path(), root).string());
        }
    }
    std::sort(files.begin(), files.end());
    return files;
}

std::string sourceText(const std::string& path) {
    return contentOf(fs::path(PALLAX_SOURCE_DIR) / path);
}

std::string folderOf(const std::string& path) {
    return fs::path(path).parent_path().string();
}

} // namespace pallax::doubles
