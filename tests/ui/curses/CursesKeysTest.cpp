#include "ui/curses/CursesKeys.h"

#include "ui/curses/Curses.h"

#include <gtest/gtest.h>

#include <tuple>
#include <utility>

namespace pallax::terminal {
namespace {

TEST(CursesKeysTest, EveryKeyCodeInUseHasItsKey) {
    const std::pair<unsigned, Key> expected[] = {
        {KEY_UP, Key::Up},        {KEY_DOWN, Key::Down},
        {KEY_LEFT, Key::Left},    {KEY_RIGHT, Key::Right},
        {KEY_PPAGE, Key::PageUp}, {KEY_NPAGE, Key::PageDown},
        {KEY_HOME, Key::Home},    {KEY_END, Key::End},
        {KEY_ENTER, Key::Enter},  {KEY_BACKSPACE, Key::Backspace},
        {KEY_DC, Key::Delete},    {KEY_BTAB, Key::BackTab},
    };
    for (const auto& [code, key] : expected) {
        const auto event = keyOfCode(code);
        ASSERT_TRUE(event.has_value()) << code;
        EXPECT_EQ(event->key, key) << code;
        EXPECT_EQ(event->character, U'\0') << code;
    }
}

TEST(CursesKeysTest, OtherCodesMeanNothing) {
    for (const unsigned code : {unsigned{KEY_RESIZE}, unsigned{KEY_F(1)}, unsigned{KEY_IC}, 0U,
                                unsigned{'a'}, 0xFFFFFFFFU}) {
        EXPECT_FALSE(keyOfCode(code).has_value()) << code;
    }
}

TEST(CursesKeysTest, SequencesThatTheTerminalsDescriptionDoesNotTellHaveTheirKeysToo) {
    const std::tuple<const char*, char32_t, Key> expected[] = {
        {"", U'A', Key::Up},      {"", U'B', Key::Down},    {"", U'C', Key::Right},
        {"", U'D', Key::Left},    {"", U'H', Key::Home},    {"", U'F', Key::End},
        {"", U'Z', Key::BackTab}, {"", U'M', Key::Enter},   {"1", U'~', Key::Home},
        {"7", U'~', Key::Home},   {"4", U'~', Key::End},    {"8", U'~', Key::End},
        {"3", U'~', Key::Delete}, {"5", U'~', Key::PageUp}, {"6", U'~', Key::PageDown},
    };
    for (const auto& [parameters, final, key] : expected) {
        const auto event = keyOfSequence(parameters, final);
        ASSERT_TRUE(event.has_value()) << parameters;
        EXPECT_EQ(event->key, key) << parameters;
    }
    for (const auto& [parameters, final] :
         {std::pair{"200", U'~'}, {"", U'I'}, {"1;5", U'A'}, {"", U'~'}, {"5", U'A'}}) {
        EXPECT_FALSE(keyOfSequence(parameters, final).has_value()) << parameters;
    }
}

TEST(CursesKeysTest, CharactersThatStandForKeysBecomeThem) {
    const std::pair<char32_t, Key> expected[] = {
        {U'\r', Key::Enter},     {U'\n', Key::Enter},    {U'\t', Key::Tab},
        {U'\b', Key::Backspace}, {0x7F, Key::Backspace}, {0x1B, Key::Escape},
    };
    for (const auto& [character, key] : expected) {
        EXPECT_EQ(keyOfCharacter(character).key, key) << static_cast<unsigned>(character);
    }
}

TEST(CursesKeysTest, OtherCharactersAreThemselves) {
    for (const char32_t character : {U'a', U' ', U'漢', U'\U0001F600', controlKey('l'), U'\0'}) {
        const KeyEvent event = keyOfCharacter(character);
        EXPECT_EQ(event.key, Key::Character);
        EXPECT_EQ(event.character, character);
    }
}

} // namespace
} // namespace pallax::terminal
