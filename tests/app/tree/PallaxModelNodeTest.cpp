#include "app/tree/PallaxModelNode.h"

#include "LogGenerator/Records/ArrayLock.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <future>

namespace pallax {
namespace {

constexpr NumberFormat kDbm{"%d dBm"};

/// A tree as text, "name=value" for a leaf and "name(children)" for a branch.
std::string shown(const NodeRef& node) {
    if (!node) {
        return "none";
    }
    if (node->childNodes() == nullptr) {
        return node->displayName() + "=" + node->value()->string().value();
    }
    std::string text = node->displayName() + "(";
    for (const NodeRef& child : *node->childNodes()) {
        text += (text.back() == '(' ? "" : " ") + shown(child);
    }
    return text + ")";
}

class PallaxModelNodeTest : public testing::Test {
protected:
    std::string treeOf(const PropertyList& object) {
        paths.clear();
        root = PallaxModelNode::makeTreeFromObject(object, paths);
        return shown(root);
    }
    std::vector<std::string> sortedPaths() const {
        std::vector<std::string> all;
        for (const auto& [path, node] : paths) {
            all.push_back(path);
        }
        std::sort(all.begin(), all.end());
        return all;
    }
    using Paths = std::vector<std::string>;

    PathDictionary paths;
    NodeRef root;
};

Dictionary sortedExample() {
    return Dictionary{{"_sorted", "1"}, {"2;B", "x"}, {"1;A", "y"}, {"C", "z"}};
}

TEST_F(PallaxModelNodeTest, EmptyDisplayDictionaryYieldsARootBranchPallaxWithNoRows) {
    EXPECT_EQ(treeOf(Dictionary{}), "Pallax()");
    ASSERT_NE(root->childNodes(), nullptr);
    EXPECT_TRUE(root->childNodes()->empty());
    EXPECT_EQ(root->value(), nullptr);
    EXPECT_EQ(sortedPaths(), Paths{"/"});
    EXPECT_EQ(paths.at("/"), root);
}

TEST_F(PallaxModelNodeTest, SortedDictionaryYieldsChildrenABCInThatOrder) {
    EXPECT_EQ(treeOf(sortedExample()), "Pallax(A=y B=x C=z)");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/A", "/B", "/C"}));
    EXPECT_EQ(paths.at("/A"), root->childNodes()->at(0));
    EXPECT_EQ(paths.at("/C"), root->childNodes()->at(2));
}

TEST_F(PallaxModelNodeTest, SameDictionaryWithoutSortedKeepsTheNamesWhole) {
    Dictionary object = sortedExample();
    object.remove("_sorted");
    EXPECT_EQ(treeOf(object), "Pallax(2;B=x 1;A=y C=z)");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/1;A", "/2;B", "/C"}));
}

TEST_F(PallaxModelNodeTest, AKeyOfThreePiecesInASortedDictionaryKeepsItsWholeTextAsName) {
    EXPECT_EQ(treeOf(Dictionary{{"_sorted", "1"}, {"a;b;c", "x"}, {";;", "y"}}),
              "Pallax(;;=y a;b;c=x)");
}

TEST_F(PallaxModelNodeTest, SortingIsByTextNotByNumber) {
    EXPECT_EQ(treeOf(Dictionary{{"2;5", "x"}, {"10;7", "y"}, {"_sorted", "1"}}), "Pallax(7=y 5=x)");
}

TEST_F(PallaxModelNodeTest, SortingIsCaseSensitiveByCharacterCode) {
    EXPECT_EQ(treeOf(Dictionary{{"_sorted", "1"},
                                {"\xC3\xA9", "0"},
                                {"a", "1"},
                                {"B", "2"},
                                {"ab", "3"},
                                {"A", "4"},
                                {"0", "5"}}),
              "Pallax(0=5 A=4 B=2 a=1 ab=3 \xC3\xA9=0)");
}

TEST_F(PallaxModelNodeTest, TheWholeKeyIsSortedNotTheNameThatIsShown) {
    EXPECT_EQ(treeOf(Dictionary{{"_sorted", "1"}, {"b;A", "x"}, {"a;B", "y"}, {"a", "z"}}),
              "Pallax(a=z B=y A=x)");
}

TEST_F(PallaxModelNodeTest, ArrayOfThreeStringsYieldsLeaves012) {
    EXPECT_EQ(treeOf(Dictionary{{"Cells", Array{"a", "b", "c"}}}), "Pallax(Cells(0=a 1=b 2=c))");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/Cells", "/Cells/0", "/Cells/1", "/Cells/2"}));
}

TEST_F(PallaxModelNodeTest, NumberValueYieldsALeafThatReadsUnknown) {
    EXPECT_EQ(treeOf(Dictionary{{"N", PropertyList::integer(7)}}), "Pallax(N=(unknown))");
    EXPECT_TRUE(paths.at("/N")->value()->isString());
}

TEST_F(PallaxModelNodeTest, AnythingElseIsALeafThatReadsUnknown) {
    EXPECT_EQ(treeOf(Dictionary{{"real", PropertyList::real(0.5)},
                                {"date", Date(std::chrono::seconds(0))},
                                {"data", PropertyList::data({1})},
                                {"boolean", PropertyList::boolean(true)}}),
              "Pallax(real=(unknown) date=(unknown) data=(unknown) boolean=(unknown))");
    EXPECT_EQ(treeOf(PropertyList::integer(1)), "Pallax=(unknown)");
}

TEST_F(PallaxModelNodeTest, ValueThatIsAnEmptyArrayOrDictionaryYieldsABranchWithNoRows) {
    EXPECT_EQ(treeOf(Dictionary{{"List", Array{}}, {"Section", Dictionary{}}}),
              "Pallax(List() Section())");
    ASSERT_NE(paths.at("/List")->childNodes(), nullptr);
    EXPECT_TRUE(paths.at("/List")->childNodes()->empty());
    EXPECT_EQ(paths.at("/List")->value(), nullptr);
}

TEST_F(PallaxModelNodeTest, TheRootCanBeALeafOrAnArray) {
    EXPECT_EQ(treeOf("text"), "Pallax=text");
    EXPECT_EQ(sortedPaths(), Paths{"/"});
    EXPECT_EQ(treeOf(Array{"x"}), "Pallax(0=x)");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/0"}));
}

TEST_F(PallaxModelNodeTest, ANullObjectHasNoTreeAndNothingIsStored) {
    EXPECT_EQ(treeOf(PropertyList()), "none");
    EXPECT_TRUE(paths.empty());
}

TEST_F(PallaxModelNodeTest, ALeafKeepsTheNumberBehindItsText) {
    treeOf(Dictionary{{"Power", DisplayNumber(std::int64_t{-80}, kDbm)}});
    const PropertyList* value = paths.at("/Power")->value();
    EXPECT_EQ(value->string(), "-80 dBm");
    EXPECT_EQ(value->displayNumber()->integer(), -80);
    EXPECT_EQ(value->displayNumber()->unit(), "dBm");
    EXPECT_EQ(paths.at("/Power")->childNodes(), nullptr);
}

TEST_F(PallaxModelNodeTest, WithoutSortedTheDictionarysOwnOrderIsKept) {
    EXPECT_EQ(treeOf(Dictionary{{"z", "1"}, {"a", Dictionary{{"d", "2"}, {"c", "3"}}}}),
              "Pallax(z=1 a(d=2 c=3))");
}

TEST_F(PallaxModelNodeTest, SortedHoldsForItsOwnDictionaryOnly) {
    EXPECT_EQ(treeOf(Dictionary{{"2;b", Dictionary{{"_sorted", "1"}, {"2;y", "1"}, {"1;x", "2"}}},
                                {"1;a", Dictionary{{"2;y", "3"}, {"1;x", "4"}}}}),
              "Pallax(2;b(x=2 y=1) 1;a(2;y=3 1;x=4))");
}

TEST_F(PallaxModelNodeTest, AnyValueUnderSortedAsksForSortingAndIsNeverShown) {
    for (const PropertyList& mark :
         {PropertyList(""), PropertyList::boolean(false), PropertyList(Dictionary{{"x", "y"}})}) {
        EXPECT_EQ(treeOf(Dictionary{{"b", "1"}, {"_sorted", mark}, {"a", "2"}}), "Pallax(a=2 b=1)");
        EXPECT_EQ(sortedPaths(), (Paths{"/", "/a", "/b"}));
    }
}

TEST_F(PallaxModelNodeTest, ANullUnderSortedAsksForNothingAndIsNotShown) {
    EXPECT_EQ(treeOf(Dictionary{{"2;b", "1"}, {"_sorted", PropertyList()}, {"1;a", "2"}}),
              "Pallax(2;b=1 1;a=2)");
}

TEST_F(PallaxModelNodeTest, AKeyWhoseValueIsNullIsSkipped) {
    EXPECT_EQ(treeOf(Dictionary{{"a", PropertyList()}, {"b", "1"}}), "Pallax(b=1)");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/b"}));
}

TEST_F(PallaxModelNodeTest, AKeyThatIsNotAStringIsSkipped) {
    Dictionary object{{"b", "1"}};
    object.appendForeignKey(PropertyList::integer(5), "five");
    EXPECT_EQ(treeOf(object), "Pallax(b=1)");
    object.set("_sorted", "1");
    EXPECT_EQ(treeOf(object), "Pallax(b=1)");
}

TEST_F(PallaxModelNodeTest, AKeyThatOnlyPrintsAsSortedAsksForNothing) {
    Dictionary object{{"2;b", "1"}, {"1;a", "2"}};
    object.appendForeignKey("_sorted", "1");
    EXPECT_EQ(treeOf(object), "Pallax(2;b=1 1;a=2)");
}

TEST_F(PallaxModelNodeTest, AnElementThatYieldsNoNodeDoesNotUseUpANumber) {
    EXPECT_EQ(treeOf(Array{PropertyList(), "a", PropertyList(), PropertyList(), "b"}),
              "Pallax(0=a 1=b)");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/0", "/1"}));
}

TEST_F(PallaxModelNodeTest, TwoKeysOfTheSameNameGiveTwoRowsAndThePathKeepsTheLater) {
    EXPECT_EQ(treeOf(Dictionary{{"02;RSSI", "-70"}, {"_sorted", "1"}, {"01;RSSI", "-80"}}),
              "Pallax(RSSI=-80 RSSI=-70)");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/RSSI"}));
    EXPECT_EQ(paths.at("/RSSI"), root->childNodes()->at(1));
}

TEST_F(PallaxModelNodeTest, ANameWithASlashMakesAPathThatLooksDeeper) {
    EXPECT_EQ(treeOf(Dictionary{{"Ec/No", Dictionary{{"dB", "-3"}}}}), "Pallax(Ec/No(dB=-3))");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/Ec/No", "/Ec/No/dB"}));
}

TEST_F(PallaxModelNodeTest, APathIsJoinedByExactlyOneSlash) {
    EXPECT_EQ(childPath("/", "Serving Cell"), "/Serving Cell");
    EXPECT_EQ(childPath("/Serving Cell", "ARFCN"), "/Serving Cell/ARFCN");
    EXPECT_EQ(childPath("/A", "/B"), "/A/B");
    EXPECT_EQ(childPath("/A/", "B"), "/A/B");
    EXPECT_EQ(childPath("/A", ""), "/A/");
    EXPECT_EQ(childPath("/A", "//"), "/A/");
    EXPECT_EQ(childPath("/", ""), "/");
}

TEST_F(PallaxModelNodeTest, TheSecondOfTwoPiecesMayBeEmpty) {
    EXPECT_EQ(treeOf(Dictionary{{"S", Dictionary{{"_sorted", "1"}, {"1;", "x"}, {";a", "y"}}}}),
              "Pallax(S(=x a=y))");
    EXPECT_EQ(sortedPaths(), (Paths{"/", "/S", "/S/", "/S/a"}));
}

TEST_F(PallaxModelNodeTest, ATreeDoesNotFollowLaterChangesOfTheDisplay) {
    const PropertyList section = Dictionary{{"ARFCN", "12"}};
    treeOf(Dictionary{{"Serving", section}});
    section.dictionary()->set("ARFCN", "13");
    section.dictionary()->set("New", "1");
    EXPECT_EQ(shown(root), "Pallax(Serving(ARFCN=12))");
}

TEST_F(PallaxModelNodeTest, NodesLiveWithoutTheirTreeAndPaths) {
    treeOf(Dictionary{{"Serving", Dictionary{{"ARFCN", "12"}}}});
    const NodeRef held = paths.at("/Serving");
    root.reset();
    paths.clear();
    EXPECT_EQ(shown(held), "Serving(ARFCN=12)");
}

TEST(PallaxModelNode, ThePlainNodeHasNeitherChildrenNorValue) {
    const PallaxModelNode node("name");
    EXPECT_EQ(node.displayName(), "name");
    EXPECT_EQ(node.childNodes(), nullptr);
    EXPECT_EQ(node.value(), nullptr);
}

/// Exits with 0 if making the tree of an array waits for the array lock, making the tree of
/// dictionaries does not, and the lock is free afterwards; otherwise with the number of the failed
/// check.
[[noreturn]] void buildWhileTheLockIsHeld() {
    const auto build = [](const PropertyList& object) {
        return std::async(std::launch::async, [object] {
            PathDictionary paths;
            return shown(PallaxModelNode::makeTreeFromObject(object, paths));
        });
    };
    const auto require = [](bool truth, int verdict) {
        if (!truth) {
            std::_Exit(verdict);
        }
    };
    constexpr std::chrono::seconds kLongEnough{10};
    ArrayLock::lockArray();
    auto free = build(Dictionary{{"a", Dictionary{{"b", "1"}}}});
    require(free.wait_for(kLongEnough) == std::future_status::ready, 1);
    require(free.get() == "Pallax(a(b=1))", 2);
    auto waiting = build(Dictionary{{"List", Array{"x"}}});
    require(waiting.wait_for(std::chrono::milliseconds(100)) == std::future_status::timeout, 3);
    ArrayLock::unlockArray();
    require(waiting.wait_for(kLongEnough) == std::future_status::ready, 4);
    require(waiting.get() == "Pallax(List(0=x))", 5);
    auto again = build(Array{"y"});
    require(again.wait_for(kLongEnough) == std::future_status::ready, 6);
    std::_Exit(0);
}

TEST(PallaxModelNodeDeathTest, TheArrayLockIsHeldWhileAnArrayIsWalkedAndNotForDictionaries) {
    // In a process of its own: a tree with nested arrays leaves the lock with its thread.
    testing::FLAGS_gtest_death_test_style = "threadsafe";
    EXPECT_EXIT(buildWhileTheLockIsHeld(), testing::ExitedWithCode(0), "");
}

TEST(PallaxModelNode, TheDepthOfTheArrayLockIsBackAfterNestedArrays) {
    const auto depth = ArrayLock::depth();
    PathDictionary paths;
    EXPECT_EQ(shown(PallaxModelNode::makeTreeFromObject(Array{Array{PropertyList(Array{"x"})}, "y"},
                                                        paths)),
              "Pallax(0(0(0=x)) 1=y)");
    EXPECT_EQ(ArrayLock::depth(), depth);
}

} // namespace
} // namespace pallax
