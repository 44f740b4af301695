#pragma once

#include "platform/ui/ModalScreen.h"
#include "platform/ui/NavigationStack.h"
#include "platform/ui/Window.h"
#include "tests/doubles/FakeViews.h"

#include <memory>
#include <utility>
#include <vector>

namespace pallax::doubles {

/// A stack that records its calls and drives its screens' life cycle: a screen is loaded and
/// appears when it reaches the top, after the delegate was called.
class FakeNavigationStack final : public ui::NavigationStack {
public:
    using ScreenRef = std::shared_ptr<ui::TableScreen>;

    FakeNavigationStack(ScreenDiary& diary, ScreenRef root)
        : _diary(diary), _screens{std::move(root)} {}

    ui::NavigationDelegate* delegate = nullptr;
    std::shared_ptr<ui::ModalScreen> modal; ///< the screen above the stack, or null

    void setDelegate(ui::NavigationDelegate* newDelegate) override {
        delegate = newDelegate;
        _diary.emplace_back(newDelegate != nullptr ? "stack setDelegate" : "stack clearDelegate");
    }
    const std::vector<ScreenRef>& screens() const override { return _screens; }
    void push(ScreenRef screen, bool animated) override {
        _diary.push_back("stack push animated=" + truth(animated));
        top().viewWillDisappear(animated);
        _screens.push_back(std::move(screen));
        top().viewDidLoad();
        show(animated);
    }
    void popTo(std::size_t index, bool animated) override {
        _diary.push_back("stack popTo " + std::to_string(index) + " animated=" + truth(animated));
        if (index + 1 >= _screens.size()) {
            return;
        }
        top().viewWillDisappear(animated);
        _screens.resize(index + 1);
        show(animated);
    }
    void showToolbar() override { _diary.emplace_back("stack showToolbar"); }
    void presentModal(std::shared_ptr<ui::ModalScreen> screen, bool animated) override {
        _diary.push_back("stack presentModal animated=" + truth(animated));
        modal = std::move(screen);
        modal->viewDidLoad();
        modal->viewWillAppear(animated);
    }
    void dismissModal(bool animated) override {
        _diary.push_back("stack dismissModal animated=" + truth(animated));
        modal.reset();
    }

    /// The root appears with its window: it is not navigated to, so the delegate is not called.
    void appearWithWindow() {
        top().viewDidLoad();
        top().viewWillAppear(false);
    }
    ui::TableScreen& top() const { return *_screens.back(); }

private:
    void show(bool animated) {
        if (delegate != nullptr) {
            delegate->navigationControllerWillShow(*this, top(), animated);
        }
        top().viewWillAppear(animated);
    }

    ScreenDiary& _diary;
    std::vector<ScreenRef> _screens;
};

class FakeWindow final : public ui::Window {
public:
    explicit FakeWindow(ScreenDiary& diary) : _diary(diary) {}
    ~FakeWindow() override { _diary.emplace_back("window released"); }
    FakeWindow(const FakeWindow&) = delete;
    FakeWindow& operator=(const FakeWindow&) = delete;

    void setRoot(ui::NavigationStack& stack) override {
        _stack = dynamic_cast<FakeNavigationStack*>(&stack);
        _diary.emplace_back("window setRoot");
    }
    void addView(ui::NavigationStack& /*stack*/) override { _diary.emplace_back("window addView"); }
    void makeKeyAndVisible() override {
        _diary.emplace_back("window makeKeyAndVisible");
        if (_stack != nullptr) {
            _stack->appearWithWindow();
        }
    }
    void takeOffScreen() override { _diary.emplace_back("window takeOffScreen"); }

private:
    ScreenDiary& _diary;
    FakeNavigationStack* _stack = nullptr;
};

} // namespace pallax::doubles
