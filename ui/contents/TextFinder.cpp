#include "ui/contents/TextFinder.h"

#include "app/pane/FindIgnoringCase.h"

#include <string_view>

namespace pallax {

std::vector<FoundRow> TextFinder::rows(const std::string& text) const {
    const NodeRef shown = root();
    return shown != nullptr ? findRows(*shown, text, _surroundings.partAt, kMostHits + 1)
                            : std::vector<FoundRow>();
}

TextFinder::Instants TextFinder::instants(const std::string& text) {
    Instants found;
    Timeline* const timeline = moment().timeline;
    if (text.empty() || timeline == nullptr) {
        return found;
    }
    found.isStopped = !_appearances->read(*timeline, _surroundings.mayGoOn);
    found.isFull = _appearances->isFull();
    found.hits = _appearances->find(*timeline, [&text](std::string_view each) {
        return findIgnoringCase(each, text) != std::string_view::npos;
    });
    return found;
}

} // namespace pallax
