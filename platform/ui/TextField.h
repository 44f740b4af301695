#pragma once

#include <string>

namespace pallax::ui {

class TextField;

class TextFieldDelegate {
public:
    virtual ~TextFieldDelegate() = default;
    /// The return key was pressed; true allows the field's default action.
    virtual bool textFieldShouldReturn(TextField& field) = 0;
};

/// An editable line of text.
class TextField {
public:
    virtual ~TextField() = default;
    /// UTF-8.
    virtual std::string text() const = 0;
    virtual void setDelegate(TextFieldDelegate* delegate) = 0;
    /// Ends editing.
    virtual void resignFirstResponder() = 0;
};

} // namespace pallax::ui
