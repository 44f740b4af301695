#include "tests/ui/terminal/StageFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>

namespace pallax::terminal {
namespace {

constexpr const char* kPath = "/snapshots/PallaxSnapshot-1700000000.pallax";

class FrontEndModalTest : public StageFixture {
protected:
    FrontEndModalTest() {
        stage.tick(display());
        stage.saveHistory = snapshotItems();
        stage.frontEnd.resize(40, 12);
        stage.type("s");
        EXPECT_NE(stage.saveScreen(), nullptr);
    }

    /// The part that takes the keys.
    std::string focus() {
        const Grid grid = draw();
        if (grid.cursor()) {
            return "Description";
        }
        return std::string(grid.at(20, 8).style.accent ? "Save" : "") +
               (grid.at(29, 8).style.accent ? "Cancel" : "");
    }
    std::string focusAfter(Key key) {
        stage.press(key);
        return focus();
    }
    /// A save screen with the items 0 to 8 and room for four.
    void openNineItems() {
        stage.closeSaveScreen();
        Array items;
        for (int item = 0; item < 9; ++item) {
            items.emplace_back(Dictionary{{"Description", "Item " + std::to_string(item)}});
        }
        stage.saveHistory = items;
        stage.frontEnd.resize(40, 8);
        stage.type("s");
        (void)draw();
    }
    /// The first and the last visible item.
    std::string itemsAfter(Key key) {
        constexpr std::size_t kNumber = std::string_view("│ ✓ Item ").size();
        stage.press(key);
        return stage.line(1).substr(kNumber, 1) + "-" + stage.line(4).substr(kNumber, 1);
    }
    /// "saved TEXT", "open" or "closed", after the posted blocks have run.
    std::string outcome() {
        stage.queue.runReady();
        const auto saved = stage.files.files.find(kPath);
        if (saved != stage.files.files.end()) {
            const DictionaryRef root = saved->second.dictionary();
            std::string text = "saved ";
            root->find("Description")->appendString(text);
            return text;
        }
        return stage.saveScreen() ? "open" : "closed";
    }
};

TEST_F(FrontEndModalTest, TheDescriptionIsEditedAtOnce) {
    EXPECT_EQ(focus(), "Description");
    stage.type("tunel");
    stage.press(Key::Left, 2);
    stage.type("n");
    EXPECT_EQ(stage.line(6), "│ Description  tunnel                  │");
    EXPECT_EQ(outcome(), "open");
}

TEST_F(FrontEndModalTest, EveryCharacterIsTextWhileItIsEdited) {
    stage.type("jkhlgGsy/?q 漢");
    EXPECT_EQ(stage.line(6), "│ Description  jkhlgGsy/?q 漢          │");
    EXPECT_EQ(stage.quits, 0);
}

TEST_F(FrontEndModalTest, EnterTwiceSaves) {
    stage.type("tunnel entrance");
    stage.press(Key::Enter);
    EXPECT_EQ(focus(), "Save");
    EXPECT_EQ(outcome(), "open");
    stage.press(Key::Enter);
    EXPECT_EQ(outcome(), "saved tunnel entrance");
    EXPECT_EQ(stage.saveScreen(), nullptr);
}

TEST_F(FrontEndModalTest, SpacePressesTheButton) {
    stage.press(Key::Tab);
    stage.type(" ");
    EXPECT_EQ(outcome(), "saved ");
}

TEST_F(FrontEndModalTest, EscCancelsWhileAnEmptyDescriptionIsEdited) {
    stage.press(Key::Escape);
    EXPECT_EQ(outcome(), "closed");
}

TEST_F(FrontEndModalTest, EscEndsTheEditingOfADescriptionAndOnlyThenCancels) {
    stage.type("text");
    stage.press(Key::Escape);
    EXPECT_EQ(outcome(), "open");
    EXPECT_EQ(focus(), "Save");
    stage.press(Key::Escape);
    EXPECT_EQ(outcome(), "closed");
}

TEST_F(FrontEndModalTest, EscCancelsFromTheButtons) {
    stage.press(Key::Enter);
    stage.press(Key::Escape);
    EXPECT_EQ(outcome(), "closed");
}

TEST_F(FrontEndModalTest, TabGoesThroughDescriptionSaveAndCancel) {
    EXPECT_EQ(focusAfter(Key::Tab), "Save");
    EXPECT_EQ(focusAfter(Key::Tab), "Cancel");
    EXPECT_EQ(focusAfter(Key::Tab), "Description");
    EXPECT_EQ(focusAfter(Key::BackTab), "Cancel");
    EXPECT_EQ(focusAfter(Key::BackTab), "Save");
    EXPECT_EQ(focusAfter(Key::BackTab), "Description");
}

TEST_F(FrontEndModalTest, UpAndDownGoTheSameWay) {
    EXPECT_EQ(focusAfter(Key::Down), "Save");
    EXPECT_EQ(focusAfter(Key::Down), "Cancel");
    EXPECT_EQ(focusAfter(Key::Down), "Description");
    EXPECT_EQ(focusAfter(Key::Up), "Cancel");
}

TEST_F(FrontEndModalTest, AnotherSaveScreenRemembersNothingOfTheOneBefore) {
    stage.type("text");
    stage.press(Key::BackTab);
    ASSERT_EQ(focus(), "Cancel");
    stage.press(Key::Enter);
    ASSERT_EQ(outcome(), "closed");
    stage.type("s");
    EXPECT_EQ(stage.line(6), "│ Description                          │");
    EXPECT_EQ(focus(), "Description");
    stage.click(0, 11); // ends editing
    EXPECT_EQ(focus(), "Save");
}

TEST_F(FrontEndModalTest, LeftAndRightChangeBetweenTheButtons) {
    stage.press(Key::Enter);
    EXPECT_EQ(focusAfter(Key::Right), "Cancel");
    EXPECT_EQ(focusAfter(Key::Left), "Save");
}

TEST_F(FrontEndModalTest, EnterOnCancelCancels) {
    stage.press(Key::BackTab);
    ASSERT_EQ(focus(), "Cancel");
    stage.press(Key::Enter);
    EXPECT_EQ(outcome(), "closed");
}

TEST_F(FrontEndModalTest, OtherKeysDoNothingOnTheButtons) {
    stage.press(Key::Enter);
    stage.type("jkhlsyq?/");
    for (const Key key : {Key::Backspace, Key::Delete, Key::Home, Key::End}) {
        stage.press(key);
    }
    EXPECT_EQ(focus(), "Save");
    EXPECT_EQ(outcome(), "open");
    EXPECT_EQ(stage.depth(), 1U);
}

TEST_F(FrontEndModalTest, TheDescriptionIsKeptWhileTheFocusGoesAround) {
    stage.type("one");
    stage.press(Key::Tab, 3);
    stage.type(" two");
    stage.press(Key::Enter, 2);
    EXPECT_EQ(outcome(), "saved one two");
}

TEST_F(FrontEndModalTest, AListLongerThanTheRoomIsCutAtItsEnd) {
    openNineItems();
    EXPECT_EQ(stage.screen(), R"(
┌ Save snapshot ───────────────────────┐
│ ✓ Item 0                             │
│ ✓ Item 1                             │
│ ✓ Item 2                             │
│ ✓ Item 3                             │
│ Description                          │
│                  [ Save ] [ Cancel ] │
└──────────────────────────────────────┘
)");
}

TEST_F(FrontEndModalTest, PgDnAndPgUpScrollALongListByAPageEach) {
    openNineItems();
    EXPECT_EQ(itemsAfter(Key::PageDown), "3-6");
    EXPECT_EQ(itemsAfter(Key::PageDown), "5-8");
    EXPECT_EQ(itemsAfter(Key::PageDown), "5-8");
    EXPECT_EQ(itemsAfter(Key::PageUp), "2-5");
    EXPECT_EQ(itemsAfter(Key::PageUp), "0-3");
    EXPECT_TRUE(draw().cursor().has_value()); // the description stays editable
}

TEST_F(FrontEndModalTest, TheWheelScrollsALongList) {
    openNineItems();
    EXPECT_EQ(itemsAfter(Key::WheelDown), "3-6");
    EXPECT_EQ(itemsAfter(Key::WheelDown), "5-8");
    EXPECT_EQ(itemsAfter(Key::WheelUp), "2-5");
}

TEST_F(FrontEndModalTest, AListThatFitsDoesNotScroll) {
    const std::string before = stage.screen();
    stage.press(Key::PageDown);
    stage.press(Key::WheelDown);
    EXPECT_EQ(stage.screen(), before);
}

TEST_F(FrontEndModalTest, ATickBelowTheSaveScreenLeavesItAlone) {
    stage.type("text");
    stage.tick(display("-99.00 dBm"));
    EXPECT_EQ(focus(), "Description");
    EXPECT_EQ(stage.line(6), "│ Description  text                    │");
}

TEST_F(FrontEndModalTest, AFailureIsAnAlertOverTheClosedScreen) {
    stage.files.failWrite = true;
    stage.press(Key::Enter, 2);
    EXPECT_EQ(outcome(), "closed");
    EXPECT_EQ(stage.screen(), R"(
 Pallax
 ──────────────────────────────────────
▌Serving Cell Measurements             ›
 Measured Neighbor Cells             3 ›
 Em┌ File Error ────────────────────┐  ›
 SI│ Unable to write file to disk   │  ›
 Op│                      [ Close ] │e
   └────────────────────────────────┘


 ──────────────────────────────────────
 Updated 2023-11-14 at 22:13:20  ? help
)");
}

} // namespace
} // namespace pallax::terminal
