#pragma once

#include "text/Bytes.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

namespace pallax::ifx {

/// Throws std::length_error: a message holds too much.
[[noreturn]] void refuseMessage();

/// Pieces up to this length are copied at this length, without a branch on how long they are; it
/// took a third of the time to mispredict that. So much may be written behind a piece.
inline constexpr std::size_t kLongestPiece = 64;

/// Letters that stand in many messages, and how many of them there are.
struct Piece {
    std::array<char, kLongestPiece> letters{};
    std::size_t size = 0;

    /// What is longer does not compile.
    constexpr Piece& add(std::string_view text) {
        for (const char letter : text) {
            letters.at(size++) = letter;
        }
        return *this;
    }
};

/// Room for some bytes of a message, without any allocation. More than it holds is refused.
template <std::size_t kCapacity>
class FixedBuffer {
public:
    static constexpr std::size_t capacity() { return kCapacity; }

    std::size_t size() const { return _size; }
    void put(std::uint8_t byte) { *room(1) = byte; }
    void put(Bytes bytes) { std::copy(bytes.begin(), bytes.end(), room(bytes.size())); }
    void put(std::string_view text) { std::copy(text.begin(), text.end(), room(text.size())); }
    /// The first `count` letters of the piece.
    void put(const Piece& piece, std::size_t count) {
        std::memcpy(room(count), piece.letters.data(), kLongestPiece);
    }
    void fill(std::size_t count, std::uint8_t byte) { std::fill_n(room(count), count, byte); }
    /// Of so many bytes, high ones first.
    void putNumber(std::uint64_t number, std::size_t width) {
        constexpr unsigned kBitsPerByte = 8;
        std::uint8_t* place = room(width);
        for (std::size_t byte = width; byte > 0; --byte) {
            *place++ = static_cast<std::uint8_t>(number >> (kBitsPerByte * (byte - 1)));
        }
    }
    /// The place of so many more bytes, which the caller sets.
    std::uint8_t* room(std::size_t count) {
        std::uint8_t* place = roomFor(count);
        _size += count;
        return place;
    }
    /// A place where so many bytes may be set; those that `take` then counts are put.
    std::uint8_t* roomFor(std::size_t count) {
        if (count > kCapacity - _size) {
            refuseMessage();
        }
        return _bytes.data() + _size;
    }
    void take(std::size_t count) { _size += count; }
    Bytes bytes() const { return Bytes(_bytes).first(_size); }

private:
    std::array<std::uint8_t, kCapacity + kLongestPiece> _bytes; // only what has been put is set
    std::size_t _size = 0;
};

using MessageBuffer = FixedBuffer<8192>;

} // namespace pallax::ifx
