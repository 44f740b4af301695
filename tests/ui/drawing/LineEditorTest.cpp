#include "ui/drawing/LineEditor.h"

#include "tests/doubles/Property.h"
#include "text/Utf8.h"
#include "ui/drawing/TextWidth.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <string>
#include <utility>
#include <vector>

namespace pallax::terminal {
namespace {

namespace any = doubles::any;

class LineEditorTest : public testing::Test {
protected:
    bool press(Key key) { return editor.handle({.key = key}); }
    bool press(char32_t character) {
        return editor.handle({.key = Key::Character, .character = character});
    }
    bool control(char letter) { return press(controlKey(letter)); }
    void type(std::u32string_view characters) {
        for (const char32_t character : characters) {
            EXPECT_TRUE(press(character));
        }
    }
    /// The text with the cursor in it.
    std::string shown() const {
        std::string text = editor.text();
        return text.insert(editor.cursor(), "|");
    }

    LineEditor editor;
};

TEST_F(LineEditorTest, IsEmptyAtFirst) {
    EXPECT_EQ(shown(), "|");
}

TEST_F(LineEditorTest, WhatIsTypedStandsBeforeTheCursor) {
    type(U"tunel");
    press(Key::Left);
    press(Key::Left);
    type(U"n");
    EXPECT_EQ(shown(), "tunn|el");
}

TEST_F(LineEditorTest, TakesUtf8OfEveryLength) {
    type(U"aé漢😀");
    EXPECT_EQ(shown(), "aé漢😀|");
    press(Key::Left);
    press(Key::Left);
    press(Key::Left);
    EXPECT_EQ(shown(), "a|é漢😀");
}

TEST_F(LineEditorTest, ArrowsStopAtTheEnds) {
    type(U"ab");
    EXPECT_TRUE(press(Key::Right));
    EXPECT_EQ(shown(), "ab|");
    press(Key::Left);
    press(Key::Left);
    EXPECT_TRUE(press(Key::Left));
    EXPECT_EQ(shown(), "|ab");
    press(Key::Right);
    EXPECT_EQ(shown(), "a|b");
}

TEST_F(LineEditorTest, HomeAndEndGoToTheEnds) {
    type(U"abc");
    EXPECT_TRUE(press(Key::Home));
    EXPECT_EQ(shown(), "|abc");
    EXPECT_TRUE(press(Key::End));
    EXPECT_EQ(shown(), "abc|");
}

TEST_F(LineEditorTest, BackspaceAndDeleteTakeOneCharacterOnEitherSide) {
    type(U"a漢b字c");
    press(Key::Left);
    press(Key::Left);
    EXPECT_TRUE(press(Key::Backspace));
    EXPECT_EQ(shown(), "a漢|字c");
    EXPECT_TRUE(press(Key::Delete));
    EXPECT_EQ(shown(), "a漢|c");
    press(Key::End);
    EXPECT_TRUE(press(Key::Delete));
    EXPECT_EQ(shown(), "a漢c|");
    press(Key::Home);
    EXPECT_TRUE(press(Key::Backspace));
    EXPECT_EQ(shown(), "|a漢c");
}

TEST_F(LineEditorTest, ACharacterAndItsCombiningOnesAreMovedOverAndDeletedAsOne) {
    type(U"xe\u0301\u0323y");
    press(Key::Left);
    EXPECT_EQ(shown(), "xe\u0301\u0323|y");
    press(Key::Left);
    EXPECT_EQ(shown(), "x|e\u0301\u0323y");
    press(Key::Delete);
    EXPECT_EQ(shown(), "x|y");
}

TEST_F(LineEditorTest, ACharacterTypedBeforeALoneCombiningOneTakesItAlong) {
    type(U"\u0301");
    EXPECT_EQ(shown(), "\u0301|");
    press(Key::Home);
    type(U"e");
    EXPECT_EQ(shown(), "e\u0301|");
    press(Key::Backspace);
    EXPECT_EQ(shown(), "|");
}

TEST_F(LineEditorTest, ControlKeysEditAsInAShell) {
    type(U"one two three");
    EXPECT_TRUE(control('a'));
    EXPECT_EQ(shown(), "|one two three");
    EXPECT_TRUE(control('f'));
    EXPECT_EQ(shown(), "o|ne two three");
    EXPECT_TRUE(control('d'));
    EXPECT_EQ(shown(), "o|e two three");
    EXPECT_TRUE(control('e'));
    EXPECT_EQ(shown(), "oe two three|");
    EXPECT_TRUE(control('b'));
    EXPECT_EQ(shown(), "oe two thre|e");
    EXPECT_TRUE(control('h'));
    EXPECT_EQ(shown(), "oe two thr|e");
    EXPECT_TRUE(control('k'));
    EXPECT_EQ(shown(), "oe two thr|");
    EXPECT_TRUE(control('w'));
    EXPECT_EQ(shown(), "oe two |");
    EXPECT_TRUE(control('u'));
    EXPECT_EQ(shown(), "|");
}

TEST_F(LineEditorTest, ControlKFromTheMiddleAndControlUToTheMiddle) {
    type(U"abcd");
    press(Key::Left);
    press(Key::Left);
    control('u');
    EXPECT_EQ(shown(), "|cd");
    press(Key::Right);
    control('k');
    EXPECT_EQ(shown(), "c|");
}

TEST_F(LineEditorTest, ControlWDeletesTheWordBeforeTheCursorAndItsBlanks) {
    type(U"one  two  ");
    control('w');
    EXPECT_EQ(shown(), "one  |");
    control('w');
    EXPECT_EQ(shown(), "|");
    EXPECT_TRUE(control('w'));
    type(U"   ");
    control('w');
    EXPECT_EQ(shown(), "|");
}

TEST_F(LineEditorTest, ControlWTakesOnlyTheWordsPartLeftOfTheCursor) {
    type(U"one two");
    press(Key::Left);
    control('w');
    EXPECT_EQ(shown(), "one |o");
}

TEST_F(LineEditorTest, OtherKeysAreNotItsOwn) {
    type(U"a");
    for (const Key key : {Key::Enter, Key::Escape, Key::Tab, Key::BackTab, Key::Up, Key::Down,
                          Key::PageUp, Key::PageDown, Key::Click, Key::WheelUp, Key::WheelDown}) {
        EXPECT_FALSE(press(key)) << static_cast<int>(key);
    }
    for (const char letter :
         {'c', 'g', 'j', 'l', 'n', 'o', 'p', 'q', 'r', 's', 't', 'v', 'x', 'y', 'z'}) {
        EXPECT_FALSE(control(letter)) << letter;
    }
    EXPECT_FALSE(press(U'\0'));
    EXPECT_EQ(shown(), "a|");
}

TEST_F(LineEditorTest, WhatIsNoCharacterIsNotTaken) {
    for (const char32_t character : {char32_t{0x7F}, char32_t{0xD800}, char32_t{0xDFFF},
                                     char32_t{0x110000}, char32_t{0xFFFFFFFF}}) {
        EXPECT_FALSE(press(character)) << static_cast<unsigned>(character);
    }
    EXPECT_EQ(shown(), "|");
}

TEST_F(LineEditorTest, WhatIsTypedBeyondTheGreatestLengthIsDropped) {
    editor.setText(std::string(LineEditor::kMaximumBytes - 1, 'a'));
    EXPECT_TRUE(press(U'é')); // two bytes, which do not fit
    EXPECT_EQ(editor.text(), std::string(LineEditor::kMaximumBytes - 1, 'a'));
    EXPECT_TRUE(press(U'b'));
    EXPECT_TRUE(press(U'c'));
    EXPECT_EQ(editor.text(), std::string(LineEditor::kMaximumBytes - 1, 'a') + "b");
}

TEST_F(LineEditorTest, ASetTextHasTheCursorBehindIt) {
    editor.setText("漢字");
    EXPECT_EQ(shown(), "漢字|");
}

bool isBoundary(const std::string& text, std::size_t offset) {
    const auto clusters = clustersOf(text);
    return offset == text.size() ||
           std::any_of(clusters.begin(), clusters.end(),
                       [offset](const Cluster& cluster) { return cluster.offset == offset; });
}

TEST_F(LineEditorTest, AfterAnyKeysTheTextIsUtf8AndTheCursorBetweenTwoCharacters) {
    const auto characters = std::to_array<char32_t>(
        {U'a', U' ', U'é', U'漢', U'\u0301', U'\u200d', U'😀', 0x85, controlKey('a'),
         controlKey('b'), controlKey('d'), controlKey('f'), controlKey('h'), controlKey('k'),
         controlKey('u'), controlKey('w')});
    constexpr auto kKeys =
        std::to_array({Key::Left, Key::Right, Key::Home, Key::End, Key::Backspace, Key::Delete,
                       Key::Character, Key::Character});
    EXPECT_TRUE(doubles::holds([&] {
        LineEditor edited;
        for (int presses = any::between(0, 100); presses > 0; --presses) {
            const Key key = any::elementOf(kKeys);
            const char32_t character = any::boolean()
                                           ? any::elementOf(characters)
                                           : static_cast<char32_t>(any::longBetween(0, 0x120000));
            (void)edited.handle({.key = key, .character = character});
            RC_ASSERT(!invalidUtf8At(edited.text()));
            RC_ASSERT(isBoundary(edited.text(), edited.cursor()));
        }
    }));
}

} // namespace
} // namespace pallax::terminal
