#pragma once

#include "ui/contents/ChangesContent.h"
#include "ui/gtk/ChangesView.h"
#include "ui/gtk/MainFrame.h"

namespace pallax {

/// The page of what differs between the marked instant and the one that is shown, in a window.
class ChangesPage {
public:
    /// Both must outlive the object.
    ChangesPage(gtk::MainFrame& frame, Travel& travel) : _frame(frame), _travel(travel) {}

    /// Marks the shown instant.
    void mark();
    /// Opens the page, or closes it.
    void toggle();
    /// Shows the changes at the shown instant, if the page is on top.
    void update();
    /// The timeline is another one.
    void forget() { _content.forget(); }

private:
    bool isOnTop() const { return _frame.pages().shows(_view.widget()); }
    void show();

    gtk::MainFrame& _frame;
    Travel& _travel;
    ChangesContent _content;
    gtk::ChangesView _view;
};

} // namespace pallax
