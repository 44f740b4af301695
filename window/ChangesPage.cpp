#include "window/ChangesPage.h"

#include "ui/contents/TravelWords.h"
#include "ui/gtk/Translation.h"

namespace pallax {

void ChangesPage::mark() {
    _frame.setMessage(markShown(_travel));
}

void ChangesPage::toggle() {
    if (isOnTop()) {
        return _frame.pages().close();
    }
    if (!_travel.marked()) {
        return _frame.setMessage(kNothingMarked);
    }
    show();
    _frame.pages().open(_view.widget(), gtk::translated("Changes"));
}

void ChangesPage::update() {
    if (isOnTop()) {
        show();
    }
}

void ChangesPage::show() {
    _content.update(_travel);
    _view.show(_content.title(), _content.lines());
}

} // namespace pallax
