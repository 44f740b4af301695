#pragma once

#include <string>

namespace pallax::ui {

class TextField;

class TextFieldDelegate {
public:
    virtual ~TextFieldDelegate() = default;
    /// The return key was pressed; true lets the field do what it does by itself.
    virtual bool textFieldShouldReturn(TextField& field) = 0;
};

/// A line of text that is edited.
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
