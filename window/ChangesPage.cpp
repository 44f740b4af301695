#include "window/ChangesPage.h"

#include "ui/contents/TravelWords.h"
#include "ui/gtk/Translation.h"

namespace pallax {

void ChangesPage::mark() {
    _frame.setMessage(markShown(_travel));
}

void ChangesPage::toggle() {
    if (isOpen()) {
        return _frame.closePage();
    }
    if (!_travel.marked()) {
        return _frame.setMessage(kNothingMarked);
    }
    show();
    _frame.openPage(_view.widget(), gtk::translated("Changes"));
}

void ChangesPage::update() {
    if (isOpen()) {
        show();
    }
}

void ChangesPage::show() {
    _content.update(_travel);
    _view.show(_content.title(), _content.lines());
}

} // namespace pallax
