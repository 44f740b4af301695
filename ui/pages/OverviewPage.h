#pragma once

#include "ui/drawing/Scrolling.h"
#include "ui/pages/OverviewText.h"
#include "ui/pages/Page.h"

#include <functional>
#include <utility>

namespace pallax::terminal {

/// What is known about the radio, on one page.
class OverviewPage {
public:
    /// Returns what is known now.
    using Source = std::function<Overview()>;

    explicit OverviewPage(Source source) : _source(std::move(source)) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    Source _source;
    Scrolling _scrolling;
};

} // namespace pallax::terminal
