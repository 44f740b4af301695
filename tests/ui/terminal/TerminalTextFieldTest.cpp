#include "ui/terminal/TerminalTextField.h"

#include <gtest/gtest.h>

namespace pallax::terminal {
namespace {

class TerminalTextFieldTest : public testing::Test, public ui::TextFieldDelegate {
protected:
    bool textFieldShouldReturn(ui::TextField& returned) override {
        EXPECT_EQ(&returned, &field);
        ++returns;
        return true;
    }

    int displays = 0;
    int returns = 0;
    TerminalTextField field{[this] { ++displays; }};
};

TEST_F(TerminalTextFieldTest, IsEditedFromItsBeginningToItsResignation) {
    EXPECT_FALSE(field.isEditing());
    field.beginEditing();
    EXPECT_TRUE(field.isEditing());
    EXPECT_EQ(displays, 1);
    field.resignFirstResponder();
    EXPECT_FALSE(field.isEditing());
    EXPECT_EQ(displays, 2);
}

TEST_F(TerminalTextFieldTest, TakesWhatIsTyped) {
    field.beginEditing();
    EXPECT_TRUE(field.handle({.key = Key::Character, .character = U'漢'}));
    EXPECT_TRUE(field.handle({.key = Key::Character, .character = U'b'}));
    EXPECT_TRUE(field.handle({.key = Key::Left}));
    EXPECT_EQ(field.text(), "漢b");
    EXPECT_EQ(field.editor().cursor(), 3U);
    EXPECT_EQ(displays, 4);
}

TEST_F(TerminalTextFieldTest, AsksItsDelegateAtTheReturnKeyAndDoesNothingByItself) {
    field.setDelegate(this);
    field.beginEditing();
    EXPECT_TRUE(field.handle({.key = Key::Enter}));
    EXPECT_EQ(returns, 1);
    EXPECT_TRUE(field.isEditing());
    EXPECT_EQ(field.text(), "");
}

TEST_F(TerminalTextFieldTest, NeedsNoDelegate) {
    field.beginEditing();
    EXPECT_TRUE(field.handle({.key = Key::Enter}));
    EXPECT_TRUE(field.isEditing());
}

TEST_F(TerminalTextFieldTest, HasNoUseForOtherKeys) {
    EXPECT_FALSE(field.handle({.key = Key::Tab}));
    EXPECT_FALSE(field.handle({.key = Key::PageDown}));
    EXPECT_EQ(displays, 0);
}

TEST_F(TerminalTextFieldTest, IsFoundBehindItsInterface) {
    ui::TextField& role = field;
    EXPECT_EQ(&terminalTextField(role), &field);
}

} // namespace
} // namespace pallax::terminal
