#pragma once

namespace pallax::ui {

class NavigationStack;

/// The application's one window. The stack outlives it.
class Window {
public:
    virtual ~Window() = default;
    virtual void setRoot(NavigationStack& stack) = 0;
    virtual void addView(NavigationStack& stack) = 0;
    virtual void makeKeyAndVisible() = 0;
    virtual void takeOffScreen() = 0;
};

} // namespace pallax::ui
