#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <string>
#include <string_view>
#include <unordered_map>

namespace pallax {

/// A list of the display, wherever its entries stand.
using ListId = std::uint32_t;
/// An entry of a list, known by what identifies it and not by its position. 0 stands for values
/// that are in no list.
using EntryId = std::uint32_t;
inline constexpr EntryId kNoEntry = 0;

/// The lists and entries that were seen, with a number for each.
class EntryTable {
public:
    /// The most entries with a number of their own. Further ones are all the entry `kOthers`.
    static constexpr std::size_t kMostEntries = 65536;
    static constexpr EntryId kOthers = 1;

    /// An identity of numbers, which is found without making its words.
    struct Numbers {
        ListId list = 0;
        EntryId outer = kNoEntry;
        std::size_t count = 0;
        std::array<std::int64_t, 4> values{};
        std::array<std::uint32_t, 4> fields{};
        std::array<const void*, 4> formats{};

        friend bool operator==(const Numbers&, const Numbers&) = default;
    };

    EntryTable();

    /// The list under a key of a section or, for a list in a list, of the outer list.
    ListId list(std::string_view section, std::string_view key, ListId outer);
    /// The entry of that identity ("Physical Cell ID 275"); `outer` is the entry that contains the
    /// list, or kNoEntry.
    EntryId entry(ListId list, EntryId outer, std::string_view identity);
    /// The entry that was noted for an identity of numbers; kNoEntry: none.
    EntryId entry(const Numbers& numbers) const;
    void note(const Numbers& numbers, EntryId entry) { _ofNumbers.emplace(numbers, entry); }
    /// The same entry when it comes for the n-th time in one list, from 2 on.
    EntryId again(EntryId entry, std::size_t time);

    /// "Physical Cell ID 275, E-ARFCN 1850". Of a list in a list, the outer entry comes first.
    const std::string& words(EntryId entry) const { return _words[entry]; }
    std::size_t entries() const { return _words.size(); }
    bool isFull() const { return _words.size() >= kMostEntries; }

private:
    struct Hash {
        std::size_t operator()(const Numbers& numbers) const;
    };

    EntryId add(std::string key, std::string words);

    std::unordered_map<std::string, ListId> _lists;
    std::unordered_map<std::string, EntryId> _entries;
    std::unordered_map<Numbers, EntryId, Hash> _ofNumbers;
    std::deque<std::string> _words; ///< by number
};

} // namespace pallax
