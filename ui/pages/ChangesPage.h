#pragma once

#include "ui/drawing/Scrolling.h"
#include "ui/pages/Page.h"

#include <functional>
#include <string>
#include <utility>
#include <vector>

namespace pallax::terminal {

/// What differs between the marked instant and the one that is shown.
class ChangesPage {
public:
    struct Content {
        std::string title;              ///< "Changes from 22:13:50 to 22:14:06"
        std::vector<std::string> lines; ///< empty: nothing differs
    };
    using Source = std::function<const Content&()>;

    explicit ChangesPage(Source source) : _source(std::move(source)) {}

    PageAnswer handle(const KeyEvent& event);
    void draw(const PageScreen& screen, const PageSurroundings& around);

private:
    Source _source;
    Scrolling _scrolling;
};

} // namespace pallax::terminal
