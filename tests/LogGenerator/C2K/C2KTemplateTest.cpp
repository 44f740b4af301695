#include "tests/LogGenerator/C2K/C2KFixture.h"
#include "tests/doubles/TemplateCheck.h"

#include <gtest/gtest.h>

#include <map>

/// How a template becomes a display and its lookup table, and the installed template.
namespace pallax {
namespace {

using namespace doubles; // NOLINT: the vocabulary of these tests
using Lines = std::vector<RecordingLog::Line>;

const RecordingLog::Line kProcessed{4, "Processing the template"};

struct Processed {
    DictionaryRef display = std::make_shared<Dictionary>();
    Dictionary lookup;
    Lines lines;
};

Processed process(const Dictionary& templateDictionary) {
    Processed processed;
    RecordingLog log;
    C2KLogGenerator::processTemplate(templateDictionary, processed.display, processed.lookup);
    processed.lines = log.take();
    return processed;
}

TEST(C2KTemplate, AStringBecomesAnEmptyRowAndAPlace) {
    const Processed processed = process({{"Channel", "kChannel"}, {"Tx", "kTxAGC"}});
    expectInOrder(processed.display, Dictionary{{"Channel", ""}, {"Tx", ""}});
    const auto channel = processed.lookup.find("kChannel")->array();
    ASSERT_EQ(channel->size(), 1U);
    EXPECT_EQ(*channel->at(0).dictionary()->find("key"), PropertyList("Channel"));
    EXPECT_EQ(channel->at(0).dictionary()->find("dict")->dictionary(), processed.display);
    EXPECT_EQ(processed.lookup.size(), 2U);
    EXPECT_EQ(processed.lines, Lines{kProcessed});
}

TEST(C2KTemplate, ANameInTwoSectionsHasTwoPlaces) {
    const Processed processed =
        process({{"Serving", Dictionary{{"Channel", "kChannel"}, {"_sorted", "_sorted"}}},
                 {"Channel", "kChannel"}});
    expectInOrder(processed.display,
                  Dictionary{{"Serving", Dictionary{{"Channel", ""}, {"_sorted", "_sorted"}}},
                             {"Channel", ""}});
    EXPECT_EQ(processed.lookup.size(), 1U) << "the mark is not a lookup name";
    const auto places = processed.lookup.find("kChannel")->array();
    ASSERT_EQ(places->size(), 2U);
    EXPECT_EQ(places->at(0).dictionary()->find("dict")->dictionary(),
              processed.display->find("Serving")->dictionary());
    EXPECT_EQ(places->at(1).dictionary()->find("dict")->dictionary(), processed.display);
    EXPECT_EQ(processed.lines, (Lines{kProcessed, kProcessed})) << "one for each dictionary";
}

TEST(C2KTemplate, TheMarkIsCopiedUnderAnyKey) {
    const Processed processed = process({{"Any", "_sorted"}, {"_sorted", "kChannel"}});
    expectInOrder(processed.display, Dictionary{{"Any", "_sorted"}, {"_sorted", ""}});
    EXPECT_EQ(processed.lookup.size(), 1U);
}

TEST(C2KTemplate, ANumberOrAnythingElseDoesNotAppear) {
    Dictionary templateDictionary = {{"Number", PropertyList::integer(1)},
                                     {"Real", PropertyList::real(0.5)},
                                     {"Truth", PropertyList::boolean(true)},
                                     {"List", Array{"kChannel"}},
                                     {"Data", PropertyList::data({1})},
                                     {"Date", Date()},
                                     {"Nothing", PropertyList()},
                                     {"Channel", "kChannel"}};
    templateDictionary.appendForeignKey(PropertyList::integer(5), "kTxAGC");
    const Processed processed = process(templateDictionary);
    expectInOrder(processed.display, Dictionary{{"Channel", ""}});
    EXPECT_EQ(processed.lookup.size(), 1U);
}

TEST(C2KTemplate, AnEmptyTemplateLogsItsLine) {
    const Processed processed = process({});
    EXPECT_TRUE(processed.display->empty());
    EXPECT_TRUE(processed.lookup.empty());
    EXPECT_EQ(processed.lines, Lines{kProcessed});
}

TEST(C2KTemplate, EmptySectionsAndDeepOnesStay) {
    const Processed processed =
        process({{"A", Dictionary{{"B", Dictionary{{"C", Dictionary()}, {"D", "kChannel"}}}}}});
    expectInOrder(processed.display,
                  Dictionary{{"A", Dictionary{{"B", Dictionary{{"C", Dictionary()}, {"D", ""}}}}}});
    EXPECT_EQ(processed.lines, (Lines{kProcessed, kProcessed, kProcessed, kProcessed}));
}

/// Counts the occurrences of each lookup name in a template.
void countNames(const PropertyList& object, std::map<std::string, int>& counts) {
    if (const DictionaryRef entries = object.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            countNames(entry.value, counts);
        }
    } else {
        ASSERT_TRUE(object.isString()) << object.description();
        ++counts[*object.string()];
    }
}

TEST(C2KTemplate, TheDeliveredOneShowsEveryLookupNameAndNoOther) {
    std::map<std::string, int> counts;
    countNames(propertyListFile(PALLAX_SOURCE_DIR "/resources/C2KTemplate.plist"), counts);
    for (const std::string& name : kLookupNames) {
        EXPECT_GE(counts[name], 1) << name;
    }
    EXPECT_EQ(counts.size(), kLookupNames.size()) << "names that no layout fills would stay empty";
}

TEST(C2KTemplate, TheDeliveredOneGroupsItsRows) {
    const PropertyList delivered =
        propertyListFile(PALLAX_SOURCE_DIR "/resources/C2KTemplate.plist");
    std::vector<std::string> groups;
    for (const Dictionary::Entry& entry : *delivered.dictionary()) {
        EXPECT_NE(entry.value.dictionary(), nullptr) << entry.key.string();
        groups.push_back(entry.key.string());
    }
    EXPECT_EQ(groups, (std::vector<std::string>{"System Identity", "1x", "EV-DO", "Data Rates"}));
}

} // namespace
} // namespace pallax
