#include "tests/reference/ReferenceFixture.h"

#include <gtest/gtest.h>

namespace pallax {
namespace {

using doubles::Keys;

/// All described keys, and each section itself as the empty key.
Keys describedKeys(const TechnologyReference& technology) {
    Keys keys = doubles::shownKeys(technology);
    for (auto& [section, hidden] : doubles::hiddenKeys(technology)) {
        keys[section].insert(hidden.begin(), hidden.end());
    }
    for (auto& [section, itsKeys] : keys) {
        itsKeys.insert("");
    }
    return keys;
}

bool isSentence(std::string_view text) {
    return text.size() > 3 && text.ends_with('.') && text.front() >= 'A' && text.front() <= 'Z' &&
           text.find('\n') == std::string_view::npos;
}

TEST(Meanings, EveryKeyAndSectionThatIsDescribedHasOne) {
    for (const TechnologyReference& technology : doubles::reference()) {
        for (const auto& [section, keys] : describedKeys(technology)) {
            for (const std::string& key : keys) {
                EXPECT_TRUE(isSentence(technology.meaningOf(section, key)))
                    << technology.title << ", section \"" << section << "\", key \"" << key
                    << "\": add a sentence to its row in the layout";
            }
        }
    }
}

/// Maps a key to the different sentences in the rows of a section.
using Sentences = std::map<std::string, std::set<std::string_view>>;

void addSentences(Sentences& sentences, const std::vector<FieldDescription>& fields) {
    for (const FieldDescription& field : fields) {
        if (!field.meaning.empty()) {
            sentences[field.key].insert(field.meaning);
        }
    }
}

Sentences sentencesOf(const SectionReference& section) {
    Sentences sentences;
    for (const CodeDescription& code : section.codes) {
        addSentences(sentences, code.fields);
        for (const SubpacketDescription& subpacket : code.subpackets) {
            addSentences(sentences, subpacket.fields);
        }
        doubles::forEachList(code, [&sentences](const ListDescription& list) {
            addSentences(sentences, list.fields);
            if (!list.meaning.empty()) {
                sentences[list.key].insert(list.meaning);
            }
        });
    }
    return sentences;
}

TEST(Meanings, TheLayoutsOfASectionSayOneOfEachKey) {
    for (const TechnologyReference& technology : doubles::reference()) {
        for (const SectionReference& section : technology.sections) {
            for (const auto& [key, sentences] : sentencesOf(section)) {
                EXPECT_EQ(sentences.size(), 1U) << section.name << ", " << key;
                EXPECT_FALSE(key.empty()) << section.name << ": " << *sentences.begin();
            }
        }
    }
}

TEST(Meanings, TheLayoutsOfATechnologyNameALogCodeOnce) {
    for (const TechnologyReference& technology : doubles::reference()) {
        std::map<LogCode, const char*> named; // a layout of CDMA may fill several sections
        for (const SectionReference& section : technology.sections) {
            for (const CodeDescription& code : section.codes) {
                if (!code.name.empty()) {
                    const auto first = named.emplace(code.logCode, code.name.data()).first;
                    EXPECT_EQ(static_cast<const void*>(first->second), code.name.data())
                        << code.name;
                }
            }
        }
    }
}

TEST(Meanings, EveryLogCodeHasAName) {
    for (const TechnologyReference& technology : doubles::reference()) {
        for (const LogCode code : codesOf(technology)) {
            EXPECT_FALSE(technology.nameOf(code).empty()) << technology.title << std::hex << code;
        }
    }
}

} // namespace
} // namespace pallax
