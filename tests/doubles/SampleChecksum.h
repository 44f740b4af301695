#pragma once

#include "LogGenerator/Records/Sample.h"
#include "text/Bytes.h"

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <optional>
#include <string_view>

namespace pallax::doubles {

/// A checksum of the field, entry, raw number and value of samples in their order, and of beginning
/// lists and removed keys, for comparison within one process.
class SampleChecksum {
public:
    /// `value` is the result of one of the functions below.
    void sample(FieldId field, std::optional<std::int64_t> raw, std::uint64_t value) {
        add(field * kFactors[0] + (raw ? static_cast<std::uint64_t>(*raw) : kNoRaw) * kFactors[1] +
            value * kFactors[2]);
    }
    void entry(std::size_t index, std::int64_t name) {
        add(index * kFactors[0] + static_cast<std::uint64_t>(name) * kFactors[1]);
    }
    /// A beginning list or a removed key.
    void key(std::string_view key) { add(of(key)); }

    static std::uint64_t of(const DisplayNumber& number) {
        return number.isReal() ? of(number.real()) : static_cast<std::uint64_t>(number.integer());
    }
    static std::uint64_t of(double number) { return std::bit_cast<std::uint64_t>(number); }
    static std::uint64_t of(std::string_view text) {
        std::uint64_t word = 0;
        if (text.size() < sizeof(word)) {
            for (const char character : text) {
                word = word << kByteBits | static_cast<unsigned char>(character);
            }
            return mixed(text.size(), word);
        }
        std::uint64_t sum = text.size();
        const std::size_t last = text.size() - sizeof(word); // may overlap the word before it
        for (std::size_t at = 0; at < last; at += sizeof(word)) {
            sum = mixed(sum, wordAt(text, at));
        }
        return mixed(sum, wordAt(text, last));
    }
    static std::uint64_t of(std::string_view text, double number) {
        return mixed(of(text), of(number));
    }

    std::uint64_t sum() const { return _sum; }

private:
    static constexpr std::uint64_t kNoRaw = 0x5555'5555'5555'5555;

    /// Odd numbers with irregular bits.
    static constexpr std::array<std::uint64_t, 3> kFactors = {
        0x9E37'79B9'7F4A'7C15, 0xC2B2'AE3D'27D4'EB4F, 0x1656'67B1'9E37'79F9};

    static std::uint64_t wordAt(std::string_view text, std::size_t at) {
        std::uint64_t word = 0;
        std::memcpy(&word, text.data() + at, sizeof(word));
        return word;
    }
    static std::uint64_t mixed(std::uint64_t sum, std::uint64_t number) {
        constexpr int kTurn = 29;
        return std::rotl((sum ^ number) * kFactors[0], kTurn);
    }
    void add(std::uint64_t number) {
        constexpr int kTurn = 13;
        _sum = std::rotl(_sum, kTurn) + number;
    }

    std::uint64_t _sum = 1;
};

} // namespace pallax::doubles
