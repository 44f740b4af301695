#pragma once

#include "platform/ui/TextField.h"
#include "ui/terminal/LineEditor.h"

#include <functional>

namespace pallax::terminal {

/// A text field that is edited with the keyboard; while it is, it has the keys.
class TerminalTextField final : public ui::TextField {
public:
    explicit TerminalTextField(std::function<void()> needsDisplay)
        : _needsDisplay(std::move(needsDisplay)) {}

    std::string text() const override { return _editor.text(); }
    void setDelegate(ui::TextFieldDelegate* delegate) override { _delegate = delegate; }
    void resignFirstResponder() override;

    bool isEditing() const { return _isEditing; }
    void beginEditing();
    /// A key while it is edited; false when the field has no use for it.
    bool handle(const KeyEvent& event);
    const LineEditor& editor() const { return _editor; }

private:
    std::function<void()> _needsDisplay;
    ui::TextFieldDelegate* _delegate = nullptr;
    LineEditor _editor;
    bool _isEditing = false;
};

/// Every text field of this front end's screens was made by its toolkit.
TerminalTextField& terminalTextField(ui::TextField& field);

} // namespace pallax::terminal
