#pragma once

#include "app/PallaxPaneController.h"
#include "monitor/Frame.h"
#include "platform/ui/NavigationStack.h"

#include <memory>

namespace pallax {

/// The panes of frames that are not the present one: a stack that begins with the panes of the live
/// one. The live panes go on meanwhile; nothing here affects them.
class HeldPanes final : private PaneApplication {
public:
    /// `live` is only read now. The toolkit must outlive the panes.
    HeldPanes(ui::Toolkit& toolkit, const ui::NavigationStack& live);
    HeldPanes(const HeldPanes&) = delete;
    HeldPanes& operator=(const HeldPanes&) = delete;

    /// Shows a frame; what differs from `before`, which may be null, counts as changed. A pane
    /// whose path the frame does not have is empty.
    void show(const FrameRef& frame, const FrameRef& before);
    ui::NavigationStack& stack() { return *_stack; }

private:
    bool allowSaveButton() const override { return false; }
    void showSaveView() override {}
    ui::NavigationStack* navigationController() override { return _stack.get(); }

    std::unique_ptr<ui::NavigationStack> _stack;
};

} // namespace pallax
