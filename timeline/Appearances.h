#pragma once

#include "timeline/Timeline.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// Where the fields of a recording and their texts appear first, numbers included.
class Appearances {
public:
    /// The most that are kept; later ones are left out.
    static constexpr std::size_t kMost = 65536;
    /// Of a field in one entry, the most numbers: a counter has another one in each packet.
    static constexpr std::size_t kMostNumbers = 1000;

    /// Something that a search has found.
    struct Hit {
        std::uint64_t packet = 0;
        Time time;
        std::string name;  ///< of a field or an entry, or the kind of an event
        std::string value; ///< the text of a field, or the words of an event; empty for an entry
        std::string where; ///< the section of a field and its entry; empty for an event
    };
    using Matches = std::function<bool(std::string_view text)>;

    Appearances();
    ~Appearances();
    Appearances(const Appearances&) = delete;
    Appearances& operator=(const Appearances&) = delete;

    /// Reads on to the latest instant; of another timeline, from the start. Decodes each packet
    /// once. False if `mayContinue` stopped it: the next call goes on there.
    bool read(Timeline& timeline, const MayContinue& mayContinue);
    /// Whether some were left out.
    bool isFull() const;
    /// What matches in the packets that were read, by packet: the first value of a field whose key
    /// or name matches, the first appearance of a text, the first value of an entry whose words
    /// match, and events.
    std::vector<Hit> find(const Timeline& timeline, const Matches& matches) const;

private:
    class Reader;

    std::unique_ptr<Reader> _reader; ///< null: nothing was read
};

} // namespace pallax
