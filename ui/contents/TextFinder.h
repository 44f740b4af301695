#pragma once

#include "app/table/FoundRows.h"
#include "timeline/Appearances.h"
#include "timeline/Moment.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// Finds a text in the shown frame, or in the whole recording, whose values are read once.
class TextFinder {
public:
    /// The most hits: all rows of a table are laid out at once.
    static constexpr std::size_t kMostHits = 1000;

    struct Surroundings {
        std::function<NodeRef()> root; ///< of the shown frame; may be null
        const EntryPartAt& partAt;
        std::function<Moment()> moment;
        /// Asked often; false stops a search of the recording.
        std::function<bool()> mayGoOn;
    };

    explicit TextFinder(Surroundings surroundings) : _surroundings(std::move(surroundings)) {}

    NodeRef root() const { return _surroundings.root(); }
    Moment moment() const { return _surroundings.moment(); }
    /// In the shown frame, in the order of the display; one more than the most if there are more.
    std::vector<FoundRow> rows(const std::string& text) const;

    struct Instants {
        std::vector<Appearances::Hit> hits; ///< by packet
        bool isStopped = false;
        bool isFull = false; ///< not all values are known
    };
    /// In the whole recording; nothing for the empty text.
    Instants instants(const std::string& text);
    /// The timeline is another one.
    void forget() { _appearances.emplace(); }

private:
    Surroundings _surroundings;
    std::optional<Appearances> _appearances{std::in_place};
};

} // namespace pallax
