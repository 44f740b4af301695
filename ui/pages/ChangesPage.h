#pragma once

#include "ui/contents/ChangesContent.h"
#include "ui/drawing/Scrolling.h"
#include "ui/pages/Page.h"

#include <functional>
#include <utility>

namespace pallax::terminal {

/// What differs between the marked instant and the one that is shown.
class ChangesPage {
public:
    using Source = std::function<const ChangesContent&()>;

    explicit ChangesPage(Source source) : _source(std::move(source)) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    Source _source;
    Scrolling _scrolling;
};

} // namespace pallax::terminal
