#pragma once

#include "platform/ui/Screen.h"
#include "platform/ui/TableView.h"
#include "platform/ui/TextField.h"
#include "platform/ui/Toolkit.h"

#include <memory>

namespace pallax::ui {

/// A screen over all others, laid out by the front end: a list, a text field, a save control, a
/// cancel control, and a background that can be touched.
class ModalScreen : public Screen, public TableSource, public TextFieldDelegate {
public:
    ModalScreen(Toolkit& toolkit, std::string_view layoutName)
        : Screen(toolkit.makeScreenView()), _outlets(toolkit.loadLayout(layoutName, *this)) {}

    virtual void savePressed() = 0;
    virtual void cancelPressed() = 0;
    virtual void backgroundTouched() = 0;

    TableView& list() { return *_outlets.list; }
    TextField& field() { return *_outlets.field; }

private:
    ModalOutlets _outlets;
};

} // namespace pallax::ui
