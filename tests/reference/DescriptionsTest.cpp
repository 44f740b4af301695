#include "LogGenerator/C2K/C2KLogGenerator.h"
#include "reference/ReferenceFiles.h"
#include "reference/SectionsPage.h"
#include "tests/doubles/C2KLookupNames.h"
#include "tests/reference/ReferenceFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace pallax {
namespace {

TEST(Descriptions, EveryFieldTellsWhereItComesFrom) {
    for (const TechnologyReference& technology : doubles::reference()) {
        for (const SectionReference& section : technology.sections) {
            for (const CodeDescription& code : section.codes) {
                if (code.showsElements()) {
                    continue;
                }
                for (const FieldDescription& field : code.fields) {
                    const int sources = (field.position ? 1 : 0) + (field.listKey.empty() ? 0 : 1) +
                                        (field.formula.empty() ? 0 : 1);
                    EXPECT_EQ(sources, 1) << section.name << ", " << field.key;
                    EXPECT_EQ(field.formula.empty(), field.computation.empty()) << field.key;
                    EXPECT_EQ(field.formula.empty(), field.read.empty()) << field.key;
                }
            }
        }
    }
}

TEST(Descriptions, TheParsersOfCdmaDescribeEveryLookupName) {
    std::set<std::string> described;
    for (const CodeLayout* layout : C2KLogGenerator::layouts()) {
        described.merge(doubles::keysOf(describe(*layout), true));
    }
    std::vector<std::string> names = doubles::kLookupNames;
    std::sort(names.begin(), names.end());
    EXPECT_EQ(std::vector<std::string>(described.begin(), described.end()), names);
}

TEST(Descriptions, EveryComputationIsOneOfTheDissectors) {
    const std::string program = dissectorProgram(PALLAX_SOURCE_DIR);
    const auto expectIn = [&program](const std::vector<FieldDescription>& fields) {
        for (const FieldDescription& field : fields) {
            const std::string function =
                "computations[\"" + std::string(field.computation) + "\"] = function";
            EXPECT_TRUE(field.computation.empty() || field.computation == "scaled energy" ||
                        program.find(function) != std::string::npos)
                << function;
        }
    };
    for (const TechnologyReference& technology : doubles::reference()) {
        for (const SectionReference& section : technology.sections) {
            for (const CodeDescription& code : section.codes) {
                expectIn(code.fields);
                for (const SubpacketDescription& subpacket : code.subpackets) {
                    expectIn(subpacket.fields);
                }
                doubles::forEachList(code,
                                     [&](const ListDescription& list) { expectIn(list.fields); });
            }
        }
    }
}

/// The page's text without roff markup.
std::string plain(std::string page) {
    for (const auto& [mark, text] : std::map<std::string, std::string>{
             {"\\fB", ""}, {"\\fR", ""}, {"\\fI", ""}, {"\\-", "-"}, {"\\(aq", "'"}}) {
        for (std::size_t at = page.find(mark); at != std::string::npos; at = page.find(mark, at)) {
            page.replace(at, mark.size(), text);
        }
    }
    return page;
}

TEST(SectionsPage, HoldsEverySectionWithEveryKeyAndItsMeaning) {
    const std::vector<TechnologyReference> technologies = doubles::reference();
    const std::string page = plain(sectionsPage(technologies));
    for (const TechnologyReference& technology : technologies) {
        const std::size_t start = page.find("\n.SH " + std::string(technology.title) + "\n");
        ASSERT_NE(start, std::string::npos) << technology.title;
        const std::string chapter = page.substr(start, page.find("\n.SH ", start + 1) - start);
        for (const auto& [section, keys] : doubles::shownKeys(technology)) {
            const std::size_t heading =
                chapter.find(".SS " + std::string(technology.title) + ": " + section + "\n");
            ASSERT_NE(heading, std::string::npos) << section;
            const std::string part =
                chapter.substr(heading, chapter.find(".SS ", heading + 1) - heading);
            for (const std::string& key : keys) {
                EXPECT_TRUE(part.find(".TP\n" + key + "\n") != std::string::npos ||
                            part.find("Entries of \\(dq" + key + "\\(dq") != std::string::npos)
                    << section << ", " << key;
                std::string meaning(technology.meaningOf(section, key));
                EXPECT_NE(part.find(plain(meaning.substr(0, meaning.find('"')))), std::string::npos)
                    << section << ", " << key;
            }
        }
        for (const LogCode code : codesOf(technology)) {
            EXPECT_NE(chapter.find(std::string(technology.nameOf(code)) + "."), std::string::npos);
        }
    }
}

} // namespace
} // namespace pallax
