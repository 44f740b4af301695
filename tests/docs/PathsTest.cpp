#include "tests/docs/SourceTree.h"
#include "tests/doubles/Pattern.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <set>
#include <string>
#include <vector>

// Checks that the files and folders that documents name or link to exist.

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::folderOf;
using doubles::matchesIn;
using doubles::replaced;
using doubles::sourceFiles;
using doubles::sourceText;

/// Whether a path is a placeholder: an example that the reader adds, or any name.
bool isInvented(const std::string& path) {
    return path.find("Example") != std::string::npos || path.find("NAME") != std::string::npos;
}

/// All texts that the pattern's group matches outside fenced blocks.
std::set<std::string> found(const std::string& document, const std::string& pattern) {
    std::set<std::string> texts;
    for (const auto& match : matchesIn(replaced(document, "```[^`]*```", ""), pattern)) {
        texts.insert(match[1]);
    }
    return texts;
}

bool exists(const std::string& folder, const std::string& path) {
    const fs::path whole = fs::path(PALLAX_SOURCE_DIR) / folder / path;
    return fs::exists(whole) || fs::exists(whole.string() + ".h"); // may be named without ".h"
}

/// Calls `look` with the folder and text of each document.
template <class Look>
void forEachDocument(const Look& look) {
    const std::vector<std::string> documents = sourceFiles({".md"});
    EXPECT_GT(documents.size(), 30U);
    for (const std::string& document : documents) {
        SCOPED_TRACE(document);
        look(folderOf(document), sourceText(document));
    }
}

TEST(Paths, BetweenBackticksExist) {
    const std::string withFolder = "`([A-Za-z0-9_.-]+(?:/[A-Za-z0-9_.-]+)*/[A-Za-z0-9_.-]*)`";
    forEachDocument([&](const std::string& folder, const std::string& text) {
        for (const std::string& path : found(text, withFolder)) {
            EXPECT_TRUE(isInvented(path) || exists("", path) || exists(folder, path)) << path;
        }
    });
}

TEST(Paths, ThatAreFileNamesAreOfSomeFile) {
    const std::string fileName = "`([A-Za-z0-9_-]+\\.(?:h|cpp|plist|lua|md))`";
    std::set<std::string> names;
    for (const std::string& path : sourceFiles({".h", ".cpp", ".plist", ".lua", ".md"})) {
        names.insert(fs::path(path).filename().string());
    }
    forEachDocument([&](const std::string& /*folder*/, const std::string& text) {
        for (const std::string& name : found(text, fileName)) {
            EXPECT_TRUE(isInvented(name) || names.contains(name)) << name;
        }
    });
}

TEST(Paths, ThatAreLinkedToExist) {
    const std::string link = "\\]\\(([^)#:]+)\\)";
    forEachDocument([&](const std::string& folder, const std::string& text) {
        for (const std::string& path : found(text, link)) {
            EXPECT_TRUE(exists(folder, path)) << path;
        }
    });
}

} // namespace
} // namespace pallax
