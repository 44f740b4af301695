#include "ui/curses/MouseReports.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <string>
#include <tuple>

namespace pallax::terminal {
namespace {

TEST(MouseReportsTest, EachReportInUseHasItsEvent) {
    const std::tuple<const char*, char32_t, Key> expected[] = {
        {"<0;12;24", U'M', Key::Click},     {"<0;12;24", U'm', Key::Release},
        {"<4;12;24", U'M', Key::Click},     {"<16;12;24", U'M', Key::Click}, // with a modifier
        {"<32;12;24", U'M', Key::Drag},     {"<64;12;24", U'M', Key::WheelUp},
        {"<65;12;24", U'M', Key::WheelDown}};
    for (const auto& [parameters, final, key] : expected) {
        const auto event = mouseEvent(parameters, final);
        ASSERT_TRUE(event) << parameters;
        EXPECT_EQ(event->key, key) << parameters;
        EXPECT_EQ(event->x, 11) << parameters;
        EXPECT_EQ(event->y, 23) << parameters;
    }
}

TEST(MouseReportsTest, OtherButtonsMotionWithoutAButtonAndWrongReportsMeanNothing) {
    for (const char* parameters :
         {"<1;12;24", "<2;12;24", "<35;12;24", "<33;12;24", "<66;12;24", "<128;12;24", "<0;0;24",
          "<0;12;0", "<0;12", "<0;12;", "<0;12;24;1", "<;;", "<", "", "0;12;24", "<-1;12;24",
          "<0;99999999999;1", "<0;99999;1"}) {
        EXPECT_FALSE(mouseEvent(parameters, U'M')) << parameters;
    }
    EXPECT_FALSE(mouseEvent("<0;12;24", U'~'));
}

TEST(MouseReportsTest, ReportsOfThreeCharactersHaveTheSameEvents) {
    const std::pair<char32_t, Key> expected[] = {{U' ', Key::Click},
                                                 {U'#', Key::Release},
                                                 {U'@', Key::Drag},
                                                 {U'`', Key::WheelUp},
                                                 {U'a', Key::WheelDown}};
    for (const auto& [what, key] : expected) {
        const auto event = mouseEventOfCharacters(what, U'!' + 11, U'!' + 23);
        ASSERT_TRUE(event) << static_cast<unsigned>(what);
        EXPECT_EQ(event->key, key) << static_cast<unsigned>(what);
        EXPECT_EQ(event->x, 11);
        EXPECT_EQ(event->y, 23);
    }
    EXPECT_FALSE(mouseEventOfCharacters(U'!', U'!', U'!')); // the second button
    EXPECT_FALSE(mouseEventOfCharacters(U' ', U' ', U'!')); // column 0
    EXPECT_FALSE(mouseEventOfCharacters(0, U'!', U'!'));
}

bool isOnScreenIfAny(const std::optional<KeyEvent>& event) {
    return !event || (event->x >= 0 && event->y >= 0);
}

RC_GTEST_PROP(MouseReportsTest, AnyReportIsAnEventOfTheScreenOrNone, ()) {
    const auto parameters = *rc::gen::container<std::string>(
        rc::gen::element('<', ';', '0', '1', '3', '9', '-', '\xff'));
    const auto event = mouseEvent("<" + parameters, *rc::gen::element(U'M', U'm'));
    RC_ASSERT(isOnScreenIfAny(event));
    RC_ASSERT(isOnScreenIfAny(mouseEventOfCharacters(*rc::gen::arbitrary<char32_t>(),
                                                     *rc::gen::arbitrary<char32_t>(),
                                                     *rc::gen::arbitrary<char32_t>())));
}

} // namespace
} // namespace pallax::terminal
