#include "reference/ReferenceFiles.h"

#include "host/DirectoryResources.h"
#include "tests/doubles/Files.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <set>

namespace pallax {
namespace {

const std::filesystem::path kTree = PALLAX_SOURCE_DIR;

std::vector<ReferenceFile> files() {
    return referenceFiles(DirectoryResources((kTree / "resources").string()),
                          dissectorProgram(kTree.string()));
}

TEST(ReferenceFiles, TheTreeHoldsThemAsTheyAreWrittenNow) {
    for (const ReferenceFile& file : files()) {
        EXPECT_TRUE(doubles::contentOf(kTree / file.path) == file.text)
            << file.path << " is not what the records' tables make of it. Write it anew:\n"
            << "  ninja -C build/dev make_reference && build/dev/reference/make_reference .";
    }
}

TEST(ReferenceFiles, ThereIsNoOtherFileBesideTheTables) {
    std::set<std::string> written;
    for (const ReferenceFile& file : files()) {
        written.insert(file.path);
    }
    for (const auto& entry : std::filesystem::directory_iterator(kTree / "docs/records")) {
        const std::string path = "docs/records/" + entry.path().filename().string();
        EXPECT_TRUE(written.contains(path)) << path;
    }
}

} // namespace
} // namespace pallax
