#include "ui/pages/CurveKeys.h"

#include "ui/pages/Graph.h"

#include <gtest/gtest.h>

namespace pallax::terminal {
namespace {

constexpr Time kWindowStart{std::chrono::seconds(1700000000)};

Time second(int number) {
    return kWindowStart + std::chrono::seconds(number);
}

/// The middle of a column of a second.
Time middle(int number) {
    return second(number) + std::chrono::milliseconds(500);
}

class CurveKeysTest : public testing::Test {
protected:
    CurveKeysTest() { keys.fit(second(0), second(60), 60); }
    CurveKeys keys;
};

TEST_F(CurveKeysTest, TheCursorBeginsAtTheEndAndStaysInTheWindow) {
    EXPECT_FALSE(keys.cursor());
    EXPECT_TRUE(keys.handle({.key = Key::Left}));
    EXPECT_EQ(keys.cursor(), middle(59));
    EXPECT_TRUE(keys.handle({.key = Key::Left}));
    EXPECT_EQ(keys.cursor(), middle(58));
    EXPECT_TRUE(keys.handle({.key = Key::Right}));
    EXPECT_TRUE(keys.handle({.key = Key::Right}));
    EXPECT_EQ(keys.cursor(), middle(59));
    EXPECT_TRUE(keys.handle({.key = Key::Home}));
    EXPECT_TRUE(keys.handle(typed(U'h')));
    EXPECT_EQ(keys.cursor(), middle(0));
    EXPECT_TRUE(keys.handle(typed(U'l')));
    EXPECT_EQ(keys.cursor(), middle(1));
    EXPECT_TRUE(keys.handle({.key = Key::End}));
    EXPECT_EQ(keys.cursor(), middle(59));
}

TEST_F(CurveKeysTest, TheCursorStaysAtItsTimeWhileTheWindowMoves) {
    EXPECT_TRUE(keys.handle({.key = Key::Home}));
    EXPECT_TRUE(keys.handle(typed(U'l')));
    keys.fit(second(1), second(61), 60);
    EXPECT_EQ(keys.cursor(), middle(1));
    keys.fit(second(10), second(70), 60);
    EXPECT_EQ(keys.cursor(), second(10));
    keys.fit(second(10), second(10), 60);
    EXPECT_FALSE(keys.cursor());
}

TEST_F(CurveKeysTest, EachStepIsAColumnWhateverItsLength) {
    keys.fit(second(0), second(300), 71);
    EXPECT_TRUE(keys.handle({.key = Key::Home}));
    for (int column = 1; column < 71; ++column) {
        EXPECT_TRUE(keys.handle({.key = Key::Right}));
        const auto at = std::chrono::duration<double>(*keys.cursor() - second(0)).count();
        EXPECT_EQ(static_cast<int>(at / 300 * 71), column);
    }
}

TEST_F(CurveKeysTest, WithoutACurveNoKeyIsTaken) {
    keys.fit({}, {}, 0);
    for (const KeyEvent& event : {KeyEvent{.key = Key::Left}, typed(U'+'), typed(U'-'), typed(U'h'),
                                  KeyEvent{.key = Key::End}}) {
        EXPECT_FALSE(keys.handle(event));
    }
    EXPECT_EQ(keys.wordsAtCursor({{second(1), "words"}}), "");
}

TEST_F(CurveKeysTest, OtherKeysAreNotTaken) {
    EXPECT_FALSE(keys.handle({.key = Key::Enter}));
    EXPECT_FALSE(keys.handle(typed(U'x')));
}

TEST_F(CurveKeysTest, TheWordsAtTheCursorAreThoseOfItsColumn) {
    const std::vector<PlotEvent> events{{second(10), "one"},
                                        {second(10) + std::chrono::milliseconds(500), "two"},
                                        {second(11), "three"},
                                        {second(60), "last"}};
    EXPECT_EQ(keys.wordsAtCursor(events), "");
    (void)keys.handle({.key = Key::Home});
    for (int column = 0; column < 10; ++column) {
        (void)keys.handle({.key = Key::Right});
    }
    EXPECT_EQ(keys.wordsAtCursor(events), "one; two");
    (void)keys.handle({.key = Key::Right});
    EXPECT_EQ(keys.wordsAtCursor(events), "three");
    (void)keys.handle({.key = Key::End});
    EXPECT_EQ(keys.wordsAtCursor(events), "last");
}

TEST(Graph, HasAtMostSixValues) {
    Graph graph;
    for (int index = 1; index <= 6; ++index) {
        EXPECT_EQ(graph.toggle({"field " + std::to_string(index), "", ""}),
                  "In the graph (" + std::to_string(index) + " of 6): V opens it.");
    }
    EXPECT_EQ(graph.toggle({"field 7", "", ""}),
              "The graph has 6 values already: v takes one away.");
    EXPECT_EQ(graph.toggle({"field 2", "", ""}), "No longer in the graph.");
    EXPECT_EQ(graph.leaves().size(), 5U);
    EXPECT_EQ(graph.leaves()[1].field, "field 3");
}

} // namespace
} // namespace pallax::terminal
