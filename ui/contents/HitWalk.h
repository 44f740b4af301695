#pragma once

#include "travel/Travel.h"
#include "ui/contents/SearchContent.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// Goes to the next and to the previous hit of the latest search for a text, without its page.
class HitWalk {
public:
    struct Surroundings {
        TextFinder& finder;                      ///< must outlive the object
        std::function<std::size_t()> conditions; ///< how many the user has gone to (Travel)
        std::function<bool()> isPageOpen;        ///< over the panes
        /// The row under the cursor of the topmost pane.
        std::function<std::vector<std::size_t>()> cursorPlace;
        std::function<void(const std::vector<std::size_t>& place)> goToPlace;
        std::function<void(std::uint64_t packet)> goToPacket;
    };

    explicit HitWalk(Surroundings surroundings) : _surroundings(std::move(surroundings)) {}

    /// The user has gone to a hit of this search.
    void begin(std::string text, SearchScope scope);
    /// Whether the user has gone to a hit after the latest condition. If not, what is found next is
    /// where the condition becomes true (Travel::findAgain).
    bool isLatest() const;
    /// Goes to the next or the previous hit, if `isLatest`. Returns a sentence about it, which may
    /// be empty. A search of a recording asks the finder's `mayGoOn`.
    std::string go(Travel::Direction direction);
    void forget() { _search.reset(); }

private:
    struct Search {
        std::string text;
        SearchScope scope;
        std::size_t conditions; ///< how many there were
    };

    std::string goToRow(bool isForward);
    std::string goToInstant(bool isForward);

    Surroundings _surroundings;
    std::optional<Search> _search;
};

} // namespace pallax
