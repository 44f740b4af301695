#pragma once

#include "app/table/TableModel.h"
#include "ui/contents/TextFinder.h"
#include "ui/contents/TimeOfDay.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace pallax {

/// Where a search looks.
enum class SearchScope { Frame, Recording };

/// What a search has found.
enum class SearchState {
    NothingTyped,
    Found,
    NotInFrame,
    NotInRecording,
    NothingToSearch, ///< no packet has come
    Searching,
    Stopped, ///< before anything was found
};

/// Everything that contains a text, as a table.
class SearchContent {
public:
    struct Surroundings {
        TextFinder& finder; ///< must outlive the object
        std::function<void(const std::string& text, const FoundRow& row)> goToRow;
        std::function<void(const std::string& text, std::uint64_t packet)> goToPacket;
        std::function<std::chrono::seconds()> ahead; ///< local time minus UTC
        Wording wording = sameWords;
    };

    explicit SearchContent(Surroundings surroundings) : _surroundings(std::move(surroundings)) {}

    /// The first search of a recording reads all of it, and asks the finder's `mayGoOn` meanwhile.
    void search(TableModel& table, const std::string& text, SearchScope scope);
    /// Searches the frame again if it is another one.
    void refresh(TableModel& table);
    /// Goes to the hit under the cursor; false without one.
    bool goThere(TableModel& table);

    SearchScope scope() const { return _scope; }
    SearchState state() const;
    bool isSearching() const { return _isSearching; }
    bool isStopped() const { return _scope == SearchScope::Recording && _instants.isStopped; }
    /// Not all values of the recording were kept, so that some may be missing.
    bool isFull() const { return _scope == SearchScope::Recording && _instants.isFull; }
    /// There are more hits than TextFinder::kMostHits, which are shown.
    bool isCut() const { return _isCut; }

private:
    void findRows(TableModel& table);
    void findInstants(TableModel& table);

    Surroundings _surroundings;
    std::string _text;
    SearchScope _scope = SearchScope::Frame;
    NodeRef _root; ///< of the frame that was searched
    std::vector<FoundRow> _rows;
    TextFinder::Instants _instants;
    bool _isCut = false;
    bool _isSearching = false;
};

} // namespace pallax
