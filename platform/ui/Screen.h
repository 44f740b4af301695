#pragma once

#include "platform/ui/Geometry.h"
#include "platform/ui/Views.h"

#include <memory>
#include <string>

namespace pallax::ui {

/// The front end's side of a screen: what the toolkit does by itself when the screen passes one
/// of its moments on, and what it redraws. It is made before its screen and never told which one
/// that is: a front end that has to know looks for the screen whose `view()` it is.
class ScreenView {
public:
    virtual ~ScreenView() = default;
    virtual void didLoad() = 0;
    virtual void willAppear(bool animated) = 0;
    virtual void willDisappear(bool animated) = 0;
    virtual void didReceiveMemoryWarning() = 0;
    virtual void didUnload() = 0;
    virtual void resignFirstResponder() = 0;
    virtual void setFrame(const Rect& frame) = 0;
    virtual void titleChanged() = 0;
    virtual void toolbarItemsChanged(bool animated) = 0;
};

/// One screen: a title, a toolbar, and the moments of its life, which the toolkit calls. A class
/// that overrides a moment decides whether the toolkit's own handling runs.
///
/// NavigationStack says when a screen appears and disappears. It calls viewDidLoad and
/// viewDidUnload of a modal screen; for the screens that lie on it, it need not call either.
class Screen {
public:
    explicit Screen(std::unique_ptr<ScreenView> view) : _view(std::move(view)) {}
    virtual ~Screen() = default;
    Screen(const Screen&) = delete;
    Screen& operator=(const Screen&) = delete;

    virtual void viewDidLoad() { _view->didLoad(); }
    virtual void viewWillAppear(bool animated) { _view->willAppear(animated); }
    virtual void viewWillDisappear(bool animated) { _view->willDisappear(animated); }
    virtual void didReceiveMemoryWarning() { _view->didReceiveMemoryWarning(); }
    virtual void viewDidUnload() { _view->didUnload(); }

    const std::string& title() const { return _title; }
    void setTitle(std::string title) {
        _title = std::move(title);
        _view->titleChanged();
    }

    const BarItems& toolbarItems() const { return _toolbarItems; }
    void setToolbarItems(BarItems items, bool animated) {
        _toolbarItems = std::move(items);
        _view->toolbarItemsChanged(animated);
    }

    ScreenView& view() { return *_view; }

private:
    std::unique_ptr<ScreenView> _view;
    std::string _title;
    BarItems _toolbarItems;
};

} // namespace pallax::ui
