#include "ui/terminal/TerminalNavigation.h"

#include "ui/terminal/TerminalToolkit.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace pallax::terminal {
namespace {

using Diary = std::vector<std::string>;

/// Notes the calls to every screen of a stack, in order.
class DiaryPane final : public ui::TableScreen {
public:
    DiaryPane(ui::Toolkit& toolkit, Diary& diary, std::string name)
        : TableScreen(toolkit), _diary(diary), _name(std::move(name)) {}
    void viewDidLoad() override { note("loaded", false); }
    void viewWillAppear(bool animated) override { note("appears", animated); }
    void viewWillDisappear(bool animated) override { note("disappears", animated); }
    void viewDidUnload() override { note("unloaded", false); }
    std::size_t numberOfRows() const override { return 0; }
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t /*row*/) override { return nullptr; }
    void didSelectRow(std::optional<std::size_t> /*row*/) override {}
    const std::string& name() const { return _name; }

private:
    void note(const char* what, bool animated) {
        _diary.push_back(_name + " " + what + (animated ? " animated" : ""));
    }
    Diary& _diary;
    std::string _name;
};

class DiaryModal final : public ui::ModalScreen {
public:
    DiaryModal(ui::Toolkit& toolkit, Diary& diary)
        : ModalScreen(toolkit, "Layout"), _diary(diary) {}
    void viewDidLoad() override { _diary.emplace_back("modal loaded"); }
    void viewWillAppear(bool /*animated*/) override { _diary.emplace_back("modal appears"); }
    void viewWillDisappear(bool /*animated*/) override { _diary.emplace_back("modal disappears"); }
    void viewDidUnload() override { _diary.emplace_back("modal unloaded"); }
    void savePressed() override {}
    void cancelPressed() override {}
    void backgroundTouched() override {}
    bool textFieldShouldReturn(ui::TextField& /*field*/) override { return true; }
    std::size_t numberOfRows() const override { return 0; }
    std::shared_ptr<ui::TableCell> cellForRow(std::size_t /*row*/) override { return nullptr; }
    void didSelectRow(std::optional<std::size_t> /*row*/) override {}

private:
    Diary& _diary;
};

class TerminalNavigationTest : public testing::Test, public ui::NavigationDelegate {
protected:
    TerminalNavigationTest() { stack.setDelegate(this); }
    void navigationControllerWillShow(ui::NavigationStack& shown, ui::TableScreen& screen,
                                      bool animated) override {
        EXPECT_EQ(&shown, &stack);
        diary.push_back("will show " + dynamic_cast<DiaryPane&>(screen).name() +
                        (animated ? " animated" : ""));
    }
    std::shared_ptr<DiaryPane> pane(const char* name) {
        return std::make_shared<DiaryPane>(toolkit, diary, name);
    }
    Diary take() { return std::exchange(diary, {}); }

    Diary diary;
    int displays = 0;
    TerminalToolkit toolkit{[] {}};
    TerminalNavigation stack{pane("root"), [this] { ++displays; }};
};

TEST_F(TerminalNavigationTest, TheRootAppearsWhenTheWindowDoes) {
    EXPECT_TRUE(take().empty());
    stack.appear();
    EXPECT_EQ(take(), (Diary{"root appears"}));
    EXPECT_TRUE(stack.isAtRoot());
    EXPECT_GT(displays, 0);
}

TEST_F(TerminalNavigationTest, APushedPaneAppearsAfterTheDelegateIsTold) {
    const auto second = pane("second");
    stack.push(second, true);
    EXPECT_EQ(take(), (Diary{"root disappears animated", "will show second animated",
                             "second appears animated"}));
    EXPECT_EQ(&stack.top(), second.get());
    EXPECT_FALSE(stack.isAtRoot());
    EXPECT_EQ(stack.screens().size(), 2U);
}

TEST_F(TerminalNavigationTest, PoppingTakesOffEveryPaneAboveAtOnce) {
    stack.push(pane("second"), false);
    stack.push(pane("third"), false);
    take();
    stack.popTo(0, true);
    EXPECT_EQ(stack.screens().size(), 1U);
    EXPECT_EQ(take(), (Diary{"third disappears animated", "will show root animated",
                             "root appears animated"}));
    EXPECT_TRUE(stack.isAtRoot());
}

TEST_F(TerminalNavigationTest, PoppingToTheTopOrBeyondDoesNothing) {
    stack.push(pane("second"), false);
    take();
    stack.popTo(1, true);
    stack.popTo(7, true);
    EXPECT_TRUE(take().empty());
    EXPECT_EQ(stack.screens().size(), 2U);
}

TEST_F(TerminalNavigationTest, BackGoesOnePaneBackAndNowhereAtTheRoot) {
    stack.push(pane("second"), false);
    stack.push(pane("third"), false);
    stack.back();
    EXPECT_EQ(stack.screens().size(), 2U);
    stack.back();
    stack.back();
    EXPECT_EQ(stack.screens().size(), 1U);
}

TEST_F(TerminalNavigationTest, NeedsNoDelegate) {
    stack.setDelegate(nullptr);
    stack.push(pane("second"), false);
    EXPECT_EQ(take(), (Diary{"root disappears", "second appears"}));
}

TEST_F(TerminalNavigationTest, TheToolbarIsHiddenUntilItIsShown) {
    EXPECT_FALSE(stack.isToolbarShown());
    stack.showToolbar();
    EXPECT_TRUE(stack.isToolbarShown());
    EXPECT_EQ(displays, 1);
}

TEST_F(TerminalNavigationTest, AModalScreenIsLoadedAppearsAndIsEditedAtOnce) {
    const auto modal = std::make_shared<DiaryModal>(toolkit, diary);
    stack.presentModal(modal, true);
    EXPECT_EQ(take(), (Diary{"modal loaded", "modal appears"}));
    EXPECT_EQ(stack.modal(), modal);
    EXPECT_TRUE(terminalTextField(modal->field()).isEditing());
}

TEST_F(TerminalNavigationTest, ThePaneBelowAModalScreenIsToldNothing) {
    stack.push(pane("second"), false);
    take();
    stack.presentModal(std::make_shared<DiaryModal>(toolkit, diary), true);
    stack.dismissModal(true);
    EXPECT_EQ(take(),
              (Diary{"modal loaded", "modal appears", "modal disappears", "modal unloaded"}));
}

TEST_F(TerminalNavigationTest, ADismissedModalScreenDisappearsAndIsGone) {
    stack.presentModal(std::make_shared<DiaryModal>(toolkit, diary), true);
    take();
    stack.dismissModal(true);
    EXPECT_EQ(take(), (Diary{"modal disappears", "modal unloaded"}));
    EXPECT_EQ(stack.modal(), nullptr);
    EXPECT_EQ(displays, 1);
    stack.dismissModal(true);
    EXPECT_TRUE(take().empty());
}

} // namespace
} // namespace pallax::terminal
