#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <set>
#include <string>

namespace pallax {
namespace {

namespace fs = std::filesystem;
using doubles::contentOf;

/// All matches of `pattern` in a text, with its `parts` groups joined by dots.
std::set<std::string> found(const std::string& text, const std::string& pattern,
                            std::size_t parts) {
    std::set<std::string> names;
    for (const auto& match : doubles::matchesIn(text, pattern)) {
        std::string name = match[1];
        for (std::size_t part = 2; part <= parts; ++part) {
            name.append(".").append(match[part]);
        }
        names.insert(name);
    }
    return names;
}

/// "Suite.Name" of all tests in the source tree.
std::set<std::string> allTests() {
    const std::string test = R"(TEST(?:_F|_P)?\(\s*(\w+),\s*(\w+)\s*\))";
    std::set<std::string> names;
    for (const auto& entry : fs::recursive_directory_iterator(PALLAX_SOURCE_DIR "/tests")) {
        if (entry.path().extension() == ".cpp" || entry.path().extension() == ".h") {
            names.merge(found(contentOf(entry.path()), test, 2));
        }
    }
    return names;
}

TEST(SecurityNotes, EveryTestThatTheyNameExists) {
    const std::string quoted = R"(`(\w+)\.([A-Z0-9]\w+)`)";
    const auto named = found(contentOf(PALLAX_SOURCE_DIR "/docs/security.md"), quoted, 2);
    ASSERT_GT(named.size(), 20U);
    const auto tests = allTests();
    for (const std::string& name : named) {
        EXPECT_TRUE(tests.contains(name)) << name;
    }
}

TEST(SecurityNotes, EveryFuzzTargetIsNamed) {
    const std::string target = R"(pallax_fuzzer\((\w+) Fuzz)";
    const std::string notes = contentOf(PALLAX_SOURCE_DIR "/docs/security.md");
    const auto targets = found(contentOf(PALLAX_SOURCE_DIR "/fuzz/CMakeLists.txt"), target, 1);
    ASSERT_GT(targets.size(), 10U);
    for (const std::string& name : targets) {
        EXPECT_NE(notes.find("`" + name + "`"), std::string::npos) << name;
    }
}

} // namespace
} // namespace pallax
