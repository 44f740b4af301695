#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "tests/LogGenerator/GSM/ObjectStream.h"
#include "tests/doubles/Property.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace pallax {
namespace {

using Failure = GSMLogGenerator::InternalInconsistencyException;

PropertyList processed(const PropertyList& object) {
    return GSMLogGenerator::processObject(object);
}

/// Checks that the display form is `expected`, with dictionaries in the same order.
void expectForm(const PropertyList& object, const PropertyList& expected) {
    EXPECT_EQ(processed(object).description(), expected.description());
    EXPECT_EQ(processed(object), expected);
}

/// The message of the failure, after checks of its place; "none" without one.
std::string failureOf(const PropertyList& object) {
    try {
        (void)processed(object);
    } catch (const Failure& failure) {
        EXPECT_STREQ(failure.file(), "LogGenerator/GSM/GSMLogGenerator");
        EXPECT_EQ(failure.line(), 78);
        EXPECT_EQ(failure.what(),
                  std::string(failure.message()) + " (LogGenerator/GSM/GSMLogGenerator, line 78)");
        return std::string(failure.message());
    }
    return "none";
}

bool isOneEntryDictionary(const PropertyList& object) {
    const DictionaryRef entries = object.dictionary();
    return entries != nullptr && entries->size() == 1;
}

/// True when a level below the top has a dictionary of one entry.
bool holdsOneEntryDictionary(const PropertyList& object) {
    const auto isOrHolds = [](const PropertyList& value) {
        return isOneEntryDictionary(value) || holdsOneEntryDictionary(value);
    };
    if (const ArrayRef elements = object.array()) {
        return std::any_of(elements->begin(), elements->end(), isOrHolds);
    }
    const DictionaryRef entries = object.dictionary();
    return entries != nullptr &&
           std::any_of(entries->begin(), entries->end(),
                       [&](const auto& entry) { return isOrHolds(entry.value); });
}

TEST(ProcessObject, AStringIsReturnedAsItIs) {
    expectForm("x", "x");
    expectForm("", "");
}

TEST(ProcessObject, ADisplayNumberIsAStringLikeAnyOther) {
    static constexpr NumberFormat kFormat{"%.2f dBm"};
    const PropertyList form = processed(DisplayNumber(-94.5, kFormat));
    EXPECT_EQ(form.string(), "-94.50 dBm");
    EXPECT_NE(form.displayNumber(), nullptr);
}

TEST(ProcessObject, TheExampleMessageCollapsesAndLosesItsHeader) {
    expectForm(Dictionary{{"Cell", Dictionary{{"ARFCN", "12"}}},
                          {"List", Array{"header", "a", Dictionary{{"x", "b"}}}}},
               Dictionary{{"Cell", "12"}, {"List", Array{"a", "b"}}});
}

TEST(ProcessObject, ADictionaryKeepsItsKeysInItsOwnOrder) {
    expectForm(Dictionary{{"z", "1"}, {"a", "2"}, {"M", "3"}, {"10", "4"}, {"9", "5"}},
               Dictionary{{"z", "1"}, {"a", "2"}, {"M", "3"}, {"10", "4"}, {"9", "5"}});
}

TEST(ProcessObject, ADictionaryOfTwoEntriesIsKept) {
    expectForm(Dictionary{{"Cell", Dictionary{{"ARFCN", "12"}, {"BSIC", "7"}}}},
               Dictionary{{"Cell", Dictionary{{"ARFCN", "12"}, {"BSIC", "7"}}}});
}

TEST(ProcessObject, AnEmptyDictionaryIsKept) {
    expectForm(Dictionary{}, Dictionary{});
    expectForm(Dictionary{{"Cell", Dictionary{}}, {"List", Array{"header", Dictionary{}}}},
               Dictionary{{"Cell", Dictionary{}}, {"List", Array{Dictionary{}}}});
}

TEST(ProcessObject, TheInnerKeyOfAOneEntryDictionaryIsDroppedForAnyValue) {
    expectForm(Dictionary{{"K", Dictionary{{"A", Array{"header", "x"}}}}, {"L", "1"}},
               Dictionary{{"K", Array{"x"}}, {"L", "1"}});
    expectForm(Dictionary{{"K", Dictionary{{"A", Dictionary{}}}}, {"L", "1"}},
               Dictionary{{"K", Dictionary{}}, {"L", "1"}});
    expectForm(Dictionary{{"K", Dictionary{{"A", Dictionary{{"x", "1"}, {"y", "2"}}}}}},
               Dictionary{{"K", Dictionary{{"x", "1"}, {"y", "2"}}}});
}

TEST(ProcessObject, ChainsOfOneEntryDictionariesFoldCompletely) {
    expectForm(Dictionary{{"K", Dictionary{{"A", Dictionary{{"B", "x"}}}}}},
               Dictionary{{"K", "x"}});
    expectForm(Array{"header", Dictionary{{"A", Dictionary{{"B", Dictionary{{"C", "x"}}}}}}},
               Array{"x"});
}

TEST(ProcessObject, AChainFoldsAroundADictionaryThatIsKept) {
    expectForm(Dictionary{{"K", Dictionary{{"A", Dictionary{{"B", Dictionary{{"C", "x"}}},
                                                            {"D", Dictionary{{"E", "y"}}}}}}}},
               Dictionary{{"K", Dictionary{{"B", "x"}, {"D", "y"}}}});
}

TEST(ProcessObject, TheTopLevelIsNeverCollapsed) {
    expectForm(Dictionary{{"K", "x"}}, Dictionary{{"K", "x"}});
    expectForm(Dictionary{{"K", Dictionary{{"A", "x"}}}}, Dictionary{{"K", "x"}});
}

TEST(ProcessObject, TheFirstElementOfEveryArrayIsNeverShown) {
    expectForm(Array{"header", "a", "b"}, Array{"a", "b"});
    expectForm(Array{"header", Array{"inner header", "a"}, Array{"another", "b"}},
               Array{Array{"a"}, Array{"b"}});
    expectForm(Array{Dictionary{{"a", "1"}, {"b", "2"}}, "x"}, Array{"x"});
}

TEST(ProcessObject, AnArrayOfOneElementDisplaysAsAnEmptyArray) {
    expectForm(Array{"a"}, Array{});
    expectForm(Array{Dictionary{{"x", "b"}}}, Array{});
    expectForm(Dictionary{{"List", Array{"a"}}}, Dictionary{{"List", Array{}}});
}

TEST(ProcessObject, AnEmptyArrayStaysEmpty) {
    expectForm(Array{}, Array{});
}

TEST(ProcessObject, AnArrayOfOneShownElementIsNotCollapsed) {
    expectForm(Dictionary{{"List", Array{"header", "a"}}}, Dictionary{{"List", Array{"a"}}});
}

TEST(ProcessObject, AKeyThatIsNoStringIsKeptAsOne) {
    Dictionary entries{{"A", "1"}};
    entries.appendForeignKey(PropertyList::integer(7), Dictionary{{"B", "2"}});
    const DictionaryRef form = processed(entries).dictionary();
    ASSERT_EQ(form->size(), 2U);
    const Dictionary::Entry& second = *std::next(form->begin());
    EXPECT_EQ(second.key.view(), "7");
    EXPECT_FALSE(second.hasStringKey);
    EXPECT_EQ(second.value, PropertyList("2"));
}

TEST(ProcessObject, AnyOtherTypeIsAFailureThatNamesIt) {
    EXPECT_EQ(failureOf(PropertyList::integer(12)), "Unknown object of type integer encountered");
    EXPECT_EQ(failureOf(PropertyList::real(1.5)), "Unknown object of type real encountered");
    EXPECT_EQ(failureOf(Date()), "Unknown object of type date encountered");
    EXPECT_EQ(failureOf(PropertyList::data({1, 2})), "Unknown object of type data encountered");
    EXPECT_EQ(failureOf(PropertyList::boolean(true)), "Unknown object of type boolean encountered");
    EXPECT_EQ(failureOf(PropertyList()), "Unknown object of type null encountered");
    EXPECT_EQ(failureOf("12"), "none");
}

TEST(ProcessObject, TheFailureIsTheSameAnywhereInTheObject) {
    const PropertyList number = PropertyList::integer(12);
    const std::string expected = "Unknown object of type integer encountered";
    EXPECT_EQ(failureOf(Dictionary{{"A", "x"}, {"B", number}}), expected);
    EXPECT_EQ(failureOf(Array{"header", number}), expected);
    EXPECT_EQ(failureOf(Array{"header", "a", Dictionary{{"A", Array{"header", number}}}}),
              expected);
    EXPECT_EQ(failureOf(Dictionary{{"A", Dictionary{{"B", Dictionary{{"C", number}}}}}}), expected);
}

TEST(ProcessObject, TheFirstElementIsNoPlaceForAnotherTypeEither) {
    EXPECT_EQ(failureOf(Array{PropertyList::integer(2), "a", "b"}),
              "Unknown object of type integer encountered");
    EXPECT_EQ(failureOf(Array{Dictionary{{"count", PropertyList::integer(2)}}, "a"}),
              "Unknown object of type integer encountered");
}

TEST(ProcessObject, OfSeveralTheFirstInOrderIsNamed) {
    EXPECT_EQ(failureOf(Dictionary{{"A", PropertyList::boolean(true)}, {"B", Date()}}),
              "Unknown object of type boolean encountered");
}

TEST(ProcessObject, TheFormHasContainersOfItsOwn) {
    const PropertyList object =
        Dictionary{{"Cell", Dictionary{{"A", "1"}, {"B", "2"}}}, {"List", Array{"header", "a"}}};
    const PropertyList form = processed(object);
    form.dictionary()->set("Cell", "changed");
    form.dictionary()->find("List")->array()->clear();
    EXPECT_EQ(object, PropertyList(Dictionary{{"Cell", Dictionary{{"A", "1"}, {"B", "2"}}},
                                              {"List", Array{"header", "a"}}}));
    const PropertyList kept =
        Dictionary{{"K", Dictionary{{"A", Dictionary{{"B", "1"}, {"C", "2"}}}}}};
    processed(kept).dictionary()->find("K")->dictionary()->set("B", "changed");
    EXPECT_EQ(kept.description(), "{ K = { A = { B = 1; C = 2; }; }; }");
}

TEST(CanCollapse, GivesTheSingleValueOfADictionaryThatHasExactlyOneEntry) {
    EXPECT_EQ(GSMLogGenerator::canCollapse(Dictionary{{"A", "x"}}), PropertyList("x"));
    EXPECT_EQ(GSMLogGenerator::canCollapse(Dictionary{{"A", Dictionary{{"B", "x"}}}}),
              PropertyList(Dictionary{{"B", "x"}}))
        << "one level";
}

TEST(CanCollapse, GivesNullForAnythingElse) {
    EXPECT_TRUE(GSMLogGenerator::canCollapse(Dictionary{}).isNull());
    EXPECT_TRUE(GSMLogGenerator::canCollapse(Dictionary{{"A", "x"}, {"B", "y"}}).isNull());
    EXPECT_TRUE(GSMLogGenerator::canCollapse("x").isNull());
    EXPECT_TRUE(GSMLogGenerator::canCollapse(Array{"x"}).isNull());
    EXPECT_TRUE(GSMLogGenerator::canCollapse(PropertyList::integer(1)).isNull());
    EXPECT_TRUE(GSMLogGenerator::canCollapse(PropertyList()).isNull());
}

TEST(ProcessObjectProperty, BelowTheTopNoDictionaryHasOneEntry) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList object = anyMessage();
        RC_CLASSIFY(holdsOneEntryDictionary(object), "with something to collapse");
        RC_ASSERT(!holdsOneEntryDictionary(processed(object)));
    }));
}

TEST(ProcessObjectProperty, TheTopLevelKeepsItsKeysAndTheObjectItsContent) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList object = anyMessage();
        const std::string before = object.description();
        const DictionaryRef form = processed(object).dictionary();
        RC_ASSERT(std::equal(form->begin(), form->end(), object.dictionary()->begin(),
                             object.dictionary()->end(),
                             [](const auto& a, const auto& b) { return a.key == b.key; }));
        RC_ASSERT(object.description() == before);
    }));
}

TEST(ProcessObjectProperty, AnArrayIsShorterByOne) {
    EXPECT_TRUE(doubles::holds([] {
        Array elements;
        for (int count = doubles::any::between(0, 6); count > 0; --count) {
            elements.push_back(anyObject(2));
        }
        const std::size_t shown = elements.empty() ? 0 : elements.size() - 1;
        RC_ASSERT(processed(elements).array()->size() == shown);
    }));
}

TEST(ProcessObjectProperty, WithoutArraysTheFormIsItsOwnForm) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList form = processed(anyMessage(false));
        RC_ASSERT(processed(form).description() == form.description());
    }));
}

TEST(ProcessObjectProperty, AnyChainFoldsToItsInnermostValue) {
    EXPECT_TRUE(doubles::holds([] {
        const PropertyList innermost = anyObject(2);
        PropertyList chain = innermost;
        for (int links = doubles::any::between(1, 40); links > 0; --links) {
            chain = Dictionary{{"link", chain}};
        }
        PropertyList expected = processed(innermost);
        if (isOneEntryDictionary(expected)) {
            expected = GSMLogGenerator::canCollapse(expected);
        }
        RC_ASSERT(processed(chain) == PropertyList(Dictionary{{"link", expected}}));
    }));
}

} // namespace
} // namespace pallax
