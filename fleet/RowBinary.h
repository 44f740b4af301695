#pragma once

#include <bit>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace pallax {

/// Rows in ClickHouse's format RowBinary: the values one after the other, little-endian, without
/// anything between them.
class RowBinary {
public:
    template <std::integral Integer>
    RowBinary& add(Integer number) {
        constexpr unsigned kBits = 8;
        auto rest = static_cast<std::uint64_t>(number);
        for (std::size_t byte = 0; byte < sizeof number; ++byte) {
            _bytes += static_cast<char>(rest & 0xFFU);
            rest >>= kBits;
        }
        return *this;
    }
    RowBinary& add(double number) { return add(std::bit_cast<std::uint64_t>(number)); }
    RowBinary& add(std::string_view text) {
        addLength(text.size());
        _bytes += text;
        return *this;
    }
    RowBinary& add(const std::string& text) { return add(std::string_view(text)); }
    RowBinary& add(const char* text) { return add(std::string_view(text)); }
    template <class Value>
    RowBinary& add(const std::optional<Value>& value) {
        _bytes += value ? '\0' : '\1';
        return value ? add(*value) : *this;
    }

    RowBinary& append(const RowBinary& other) {
        _bytes += other._bytes;
        return *this;
    }

    const std::string& bytes() const { return _bytes; }
    void clear() { _bytes.clear(); }

private:
    void addLength(std::uint64_t length) {
        constexpr std::uint64_t kMore = 0x80;
        constexpr unsigned kBits = 7;
        while (length >= kMore) {
            _bytes += static_cast<char>(length | kMore);
            length >>= kBits;
        }
        _bytes += static_cast<char>(length);
    }

    std::string _bytes;
};

} // namespace pallax
