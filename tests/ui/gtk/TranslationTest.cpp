#include "tests/doubles/Files.h"
#include "tests/doubles/Pattern.h"
#include "ui/contents/CurveReading.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <map>
#include <set>
#include <string>

namespace pallax::gtk {
namespace {

using doubles::contentOf;
using doubles::matchesIn;

/// The texts that the sources of the window have translated.
std::set<std::string> textsOfTheSources() {
    std::set<std::string> texts;
    for (const char* folder : {"/ui/gtk", "/window"}) {
        for (const auto& entry :
             std::filesystem::directory_iterator(std::string(PALLAX_SOURCE_DIR) + folder)) {
            if (entry.path().extension() == ".cpp") {
                for (const auto& match :
                     matchesIn(contentOf(entry.path().string()), "translated\\(\\s*\"([^\"]*)\"")) {
                    texts.insert(match[1]);
                }
            }
        }
    }
    for (const CurveSpan& span : curveSpans()) { // translated where they are shown
        texts.insert(std::string(span.words));
    }
    return texts;
}

TEST(Translation, GermanIsComplete) {
    std::map<std::string, std::string> german;
    for (const auto& match : matchesIn(contentOf(PALLAX_SOURCE_DIR "/po/de.po"),
                                       "msgid \"([^\"]+)\"\nmsgstr \"([^\"]*)\"")) {
        german[match[1]] = match[2];
    }
    std::set<std::string> keys;
    for (const auto& [key, text] : german) {
        keys.insert(key);
        EXPECT_FALSE(text.empty()) << key;
    }
    const std::set<std::string> texts = textsOfTheSources();
    EXPECT_GT(texts.size(), 30U);
    EXPECT_EQ(keys, texts);
}

} // namespace
} // namespace pallax::gtk
