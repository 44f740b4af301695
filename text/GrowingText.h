#pragma once

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>

namespace pallax {

/// Text or bytes that are written piece by piece. A short piece costs a comparison and a copy, a
/// fraction of what appending to a std::string costs.
class GrowingText {
public:
    GrowingText() = default;
    /// With room for so much before it is moved.
    explicit GrowingText(std::size_t room) : _letters(room, '\0') {}

    std::size_t size() const { return _size; }
    std::string_view view(std::size_t start = 0) const {
        return {_letters.data() + start, _size - start};
    }
    /// The place of so many more, which the caller sets.
    char* grow(std::size_t count) {
        if (count > _letters.size() - _size) {
            _letters.resize(2 * (_size + count));
        }
        char* place = _letters.data() + _size;
        _size += count;
        return place;
    }
    /// Forgets all but the first `size`.
    void truncate(std::size_t size) { _size = size; }
    void put(char letter) { *grow(1) = letter; }
    void put(std::string_view text) { std::copy(text.begin(), text.end(), grow(text.size())); }
    void put(std::size_t count, char letter) { std::fill_n(grow(count), count, letter); }

private:
    std::string _letters; ///< of which the first `_size` are written
    std::size_t _size = 0;
};

} // namespace pallax
