#pragma once

#include "plist/BinaryPropertyListFormat.h"
#include "text/GrowingText.h"

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::binary_form {

/// Big-endian, in so many bytes.
void appendNumber(std::string& out, std::uint64_t number, std::size_t width);
void appendMarker(std::string& out, Kind kind, std::uint64_t low);
/// In 1, 2 or 4 bytes when it fits unsigned, else in 8.
void appendInteger(std::string& out, std::int64_t number);
/// The marker of an object of so many units or elements.
void appendCounted(std::string& out, Kind kind, std::size_t count);
/// 0 to 3: in 1, 2, 4 or 8 bytes.
std::size_t powerOfWidth(std::uint64_t number);

/// A binary property list as it is written: one object after the other, numbered from 0.
class Objects {
public:
    /// With room for so many bytes before they are moved.
    explicit Objects(std::size_t room = 0);
    void reserve(std::size_t objects) { _offsets.reserve(objects); }

    std::size_t count() const { return _offsets.size(); }
    /// An object that is already encoded, its marker included.
    void add(std::string_view encoded);
    /// A text of ASCII, or a container of `count` elements; its content is the references to them
    /// as they are written, of a dictionary first to all keys, then to all values.
    void add(Kind kind, std::size_t count, std::initializer_list<std::string_view> content) {
        begin();
        if (count < kCountFollows) {
            _bytes.put(static_cast<char>(unsigned{kind} << 4U | count));
        } else {
            putLongMarker(kind, count);
        }
        for (const std::string_view part : content) {
            _bytes.put(part);
        }
    }
    void addAscii(std::string_view text) { add(kAscii, text.size(), {text}); }
    /// The whole list, after which nothing more can be added.
    std::string_view finish(std::size_t root, std::size_t referenceWidth);

private:
    void begin() { _offsets.push_back(static_cast<std::uint32_t>(_bytes.size())); }
    void putLongMarker(Kind kind, std::size_t count);

    GrowingText _bytes;
    std::vector<std::uint32_t> _offsets;
};

} // namespace pallax::binary_form
