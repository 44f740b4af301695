#include "timeline/EntryTable.h"

#include <utility>

namespace pallax {

namespace {

std::string keyOf(std::uint32_t one, std::uint32_t other, std::string_view text) {
    std::string key = std::to_string(one);
    key.append(",").append(std::to_string(other)).append(",").append(text);
    return key;
}

} // namespace

EntryTable::EntryTable() : _words{"", "others"} {}

ListId EntryTable::list(std::string_view section, std::string_view key, ListId outer) {
    std::string name = keyOf(outer, 0, section);
    name.append("\n").append(key);
    return _lists.emplace(std::move(name), static_cast<ListId>(_lists.size() + 1)).first->second;
}

EntryId EntryTable::entry(ListId list, EntryId outer, std::string_view identity) {
    std::string key = keyOf(list, outer, identity);
    const auto found = _entries.find(key);
    if (found != _entries.end()) {
        return found->second;
    }
    std::string words = outer != kNoEntry ? _words[outer] + ", " : std::string();
    return add(std::move(key), words.append(identity));
}

EntryId EntryTable::entry(const Numbers& numbers) const {
    const auto found = _ofNumbers.find(numbers);
    return found != _ofNumbers.end() ? found->second : kNoEntry;
}

std::size_t EntryTable::Hash::operator()(const Numbers& numbers) const {
    constexpr std::uint64_t kMix = 0x9E3779B97F4A7C15; // odd, with its bits well spread
    constexpr unsigned kHalf = 32;
    std::uint64_t hash = std::uint64_t{numbers.list} << kHalf | numbers.outer;
    for (std::size_t index = 0; index < numbers.count; ++index) {
        hash = (hash ^ static_cast<std::uint64_t>(numbers.values.at(index))) * kMix;
        hash ^= hash >> kHalf;
    }
    return hash;
}

EntryId EntryTable::again(EntryId entry, std::size_t time) {
    std::string key = keyOf(entry, static_cast<std::uint32_t>(time), "again");
    key.insert(0, "=");
    const auto found = _entries.find(key);
    if (found != _entries.end()) {
        return found->second;
    }
    return add(std::move(key), _words[entry] + " (" + std::to_string(time) + ")");
}

EntryId EntryTable::add(std::string key, std::string words) {
    if (isFull()) {
        return kOthers;
    }
    const auto id = static_cast<EntryId>(_words.size());
    _entries.emplace(std::move(key), id);
    _words.push_back(std::move(words));
    return id;
}

} // namespace pallax
