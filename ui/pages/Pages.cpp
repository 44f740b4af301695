#include "ui/pages/Pages.h"

namespace pallax::terminal {

void Pages::open(Page page) {
    _pages.remove_if([&](const Page& each) { return each.index() == page.index(); });
    _pages.push_back(std::move(page));
}

PageAnswer Pages::handle(const KeyEvent& event) {
    const PageAnswer answer =
        std::visit([&](auto& page) { return page.handle(event); }, _pages.back());
    if (answer == PageAnswer::Closes) {
        closeTop();
    }
    return answer;
}

void Pages::draw(const PageScreen& screen, const PageSurroundings& around) {
    std::visit([&](auto& page) { page.draw(screen, around); }, _pages.back());
}

} // namespace pallax::terminal
