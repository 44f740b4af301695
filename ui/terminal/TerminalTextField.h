#pragma once

#include "platform/ui/TextField.h"
#include "ui/drawing/LineEditor.h"

#include <functional>

namespace pallax::terminal {

/// A text field that receives the keys while it is edited.
class TerminalTextField final : public ui::TextField {
public:
    explicit TerminalTextField(std::function<void()> needsDisplay)
        : _needsDisplay(std::move(needsDisplay)) {}

    std::string text() const override { return _editor.text(); }
    void setDelegate(ui::TextFieldDelegate* delegate) override { _delegate = delegate; }
    void resignFirstResponder() override;

    bool isEditing() const { return _isEditing; }
    void beginEditing();
    /// Handles a key during editing; false if the field does not use it.
    bool handle(const KeyEvent& event);
    const LineEditor& editor() const { return _editor; }

private:
    std::function<void()> _needsDisplay;
    ui::TextFieldDelegate* _delegate = nullptr;
    LineEditor _editor;
    bool _isEditing = false;
};

/// Every text field of this front end's screens comes from its toolkit.
TerminalTextField& terminalTextField(ui::TextField& field);

} // namespace pallax::terminal
