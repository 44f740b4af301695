#include "app/HeldPanes.h"

#include "platform/ui/Toolkit.h"

namespace pallax {

namespace {

PallaxPaneController& heldPane(ui::TableScreen& screen) {
    return dynamic_cast<PallaxPaneController&>(screen); // all panes of the stacks are
}

void showFrame(PallaxPaneController& pane, const Frame* frame) {
    if (frame == nullptr) {
        return pane.reloadWithNode(nullptr);
    }
    const NodeRef node = frame->nodeAtPath(pane.path());
    pane.reloadWithNode(node, frame->time());
    if (!node) { // its name is still the last part of its path
        pane.setTitle(pane.path().substr(pane.path().rfind('/') + 1));
    }
}

} // namespace

HeldPanes::HeldPanes(ui::Toolkit& toolkit, const ui::NavigationStack& live) {
    PaneApplication& application = *this;
    for (const auto& screen : live.screens()) {
        PaneModel& from = heldPane(*screen).pane();
        auto pane =
            std::make_shared<PallaxPaneController>(toolkit, application, nullptr, from.path());
        pane->pane().setFilter(from.filter());
        pane->pane().setOrder(from.order());
        if (_stack == nullptr) {
            pane->viewWillAppear(false);
            _stack = toolkit.makeNavigationStack(std::move(pane));
        } else {
            _stack->push(std::move(pane), false);
        }
    }
    _stack->showToolbar();
}

void HeldPanes::show(const FrameRef& frame, const FrameRef& before) {
    for (const auto& screen : _stack->screens()) {
        PallaxPaneController& pane = heldPane(*screen);
        showFrame(pane, before.get());
        showFrame(pane, frame.get());
    }
}

} // namespace pallax
