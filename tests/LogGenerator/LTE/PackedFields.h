#pragma once

#include "plist/PropertyList.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <span>
#include <string>

/// The expected content of a bit-packed record, computed without the reader: the position of each
/// key's bits, and the text of a raw value as printf formats it.
namespace pallax::doubles {

struct PackedField {
    const char* key;
    std::size_t byte;
    unsigned bit;
    unsigned width;
    std::string (*shown)(std::uint32_t raw);
};

/// The text of raw x factor + offset with that many decimals, and the text after the number.
inline std::string scaledText(std::uint32_t raw, double factor, double offset, int decimals,
                              const char* suffix) {
    std::array<char, 64> buffer{};
    (void)std::snprintf(buffer.data(), buffer.size(), "%.*f%s", decimals, raw * factor + offset,
                        suffix);
    return buffer.data();
}

inline std::string plain(std::uint32_t raw) {
    return std::to_string(raw);
}
inline std::string quarterDbm(std::uint32_t raw) {
    return scaledText(raw, 0.25, -140, 2, " dBm");
}
inline std::string halfDbm(std::uint32_t raw) {
    return scaledText(raw, 0.5, -140, 2, " dBm");
}
inline std::string quarterDb(std::uint32_t raw) {
    return scaledText(raw, 0.25, -30, 2, " dB");
}
inline std::string doubleDbm(std::uint32_t raw) {
    return scaledText(raw, 2, -140, 0, " dBm");
}
inline std::string less30Dbm(std::uint32_t raw) {
    return scaledText(raw, 1, -30, 0, " dBm");
}

/// The whole section when only bit `bit` of byte `byte` is set.
inline Dictionary withOneBit(std::span<const PackedField> fields, std::size_t byte, unsigned bit) {
    const std::size_t place = byte * 8 + bit;
    Dictionary expected;
    for (const PackedField& field : fields) {
        const std::size_t first = field.byte * 8 + field.bit;
        const bool inside = place >= first && place < first + field.width;
        const std::uint32_t raw = inside ? std::uint32_t{1} << (place - first) : 0;
        expected.set(field.key, field.shown(raw));
    }
    return expected;
}

} // namespace pallax::doubles
