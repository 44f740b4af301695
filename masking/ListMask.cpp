#include "masking/ListMask.h"

#include "masking/BitField.h"
#include "masking/IdentityFinder.h"
#include "masking/Permutation.h"
#include "plist/PropertyListCodec.h"
#include "text/Base64.h"
#include "text/Bytes.h"
#include "text/Date.h"

#include <algorithm>
#include <charconv>
#include <span>
#include <utility>
#include <vector>

namespace pallax {

namespace {

using Type = PropertyList::Type;

constexpr std::string_view kNoDate = "2001-01-01T00:00:00Z";

Bytes bytesOf(std::string_view text) {
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()}; // NOLINT
}

/// What a pseudonym depends on: the same for the same value in any form.
ByteBuffer canonical(const PropertyList& value) {
    if (const SharedBytes data = value.data()) {
        return *data;
    }
    const std::string text = value.string().value_or(value.description());
    const Bytes bytes = bytesOf(text);
    return {bytes.begin(), bytes.end()};
}

bool isDecimal(char letter) {
    return letter >= '0' && letter <= '9';
}
bool isHexadecimal(char letter) {
    return isDecimal(letter) || (letter >= 'a' && letter <= 'f') ||
           (letter >= 'A' && letter <= 'F');
}

/// Numbers in a text, each replaced by one of as many digits; "0x" begins a hexadecimal one.
std::string withOtherPlaces(std::string text, const Permutation& permutation) {
    constexpr std::size_t kMostDigits = 15;
    for (std::size_t at = 0; at < text.size();) {
        const bool isHex = text.compare(at, 2, "0x") == 0;
        const auto isPart = isHex ? isHexadecimal : isDecimal;
        const std::size_t begin = at + (isHex ? 2 : 0);
        std::size_t end = begin;
        while (end < text.size() && isPart(text[end])) {
            ++end;
        }
        std::uint64_t number = 0;
        const std::size_t count = end - begin;
        if (count > 0 && count <= kMostDigits) {
            (void)std::from_chars(text.data() + begin, text.data() + end, number, isHex ? 16 : 10);
            constexpr unsigned kDigitBits = 4;
            number = isHex ? permutation.of(number, static_cast<unsigned>(count) * kDigitBits)
                           : permutation.ofDecimal(number);
            for (std::size_t digit = end; digit > begin; --digit) {
                constexpr std::string_view kDigits = "0123456789ABCDEF";
                text[digit - 1] = kDigits[number % (isHex ? 16 : 10)];
                number /= isHex ? 16 : 10;
            }
        }
        at = std::max(end, at + 1);
    }
    return text;
}

/// Replaces the values of one list.
class Masker {
public:
    Masker(std::span<std::uint8_t> list, const Replacement& replacement, const Replacement& places)
        : _list(list), _replacement(replacement), _places(places) {}

    void replace(const ScalarPlace& place, const PropertyList& value, MaskAction action) const {
        const auto content = _list.subspan(place.content.offset, place.content.length);
        if (action == MaskAction::Place) {
            return replacePlace(place, content);
        }
        const ByteBuffer from = canonical(value);
        switch (place.coding) {
        case ScalarPlace::Coding::Letters:
            return put(content, lettersFor(place.type, from, content.size()));
        case ScalarPlace::Coding::Utf16:
            return putUtf16(content, _replacement.letters(from, content.size() / 2));
        case ScalarPlace::Coding::Base64:
            return putBase64(content, value.data(), from);
        case ScalarPlace::Coding::Hex:
            return putHex(content, from);
        case ScalarPlace::Coding::Raw:
            return putRaw(place.type, content, from);
        }
    }

    /// Blanks, or zeros in a list that is not a text.
    void blank(const ByteRange& range) const {
        const bool isBinary = formOf(_list) == PropertyListForm::Binary;
        std::fill_n(_list.begin() + static_cast<std::ptrdiff_t>(range.offset), range.length,
                    isBinary ? std::uint8_t{0} : std::uint8_t{' '});
    }

    /// The value that `replace` leaves in the bytes of such a value.
    PropertyList masked(const PropertyList& value, MaskAction action) const;

private:
    static void put(std::span<std::uint8_t> content, std::string_view text) {
        std::copy_n(text.begin(), content.size(), content.begin());
    }

    std::string lettersFor(Type type, const ByteBuffer& from, std::size_t length) const {
        switch (type) {
        case Type::kInteger:
            return _replacement.digits(from, length);
        case Type::kReal:
            return std::string(length, '0');
        case Type::kDate: {
            std::string date(kNoDate);
            date.resize(length, ' ');
            return date;
        }
        default:
            return _replacement.letters(from, length);
        }
    }

    static void putUtf16(std::span<std::uint8_t> content, std::string_view letters) {
        for (std::size_t unit = 0; unit < letters.size(); ++unit) {
            content[2 * unit] = 0;
            content[2 * unit + 1] = static_cast<std::uint8_t>(letters[unit]);
        }
    }

    /// Keeps the line breaks. A content with markup in it becomes empty data.
    void putBase64(std::span<std::uint8_t> content, const SharedBytes& data,
                   const ByteBuffer& from) const {
        const auto isMarkup = [](std::uint8_t letter) { return letter == '<' || letter == '&'; };
        if (!data || std::any_of(content.begin(), content.end(), isMarkup)) {
            std::fill(content.begin(), content.end(), std::uint8_t{' '});
            return;
        }
        const std::string text = base64Text(_replacement.bytes(from, data->size()));
        auto next = text.begin();
        for (std::uint8_t& letter : content) {
            const bool isSpace =
                letter == ' ' || letter == '\t' || letter == '\r' || letter == '\n';
            if (!isSpace && next != text.end()) {
                letter = static_cast<std::uint8_t>(*next++);
            }
        }
    }

    void putHex(std::span<std::uint8_t> content, const ByteBuffer& from) const {
        constexpr std::string_view kDigits = "0123456789abcdef";
        const ByteBuffer bytes = _replacement.bytes(from, from.size());
        std::size_t half = 0;
        for (std::uint8_t& letter : content) {
            if (isHexadecimal(static_cast<char>(letter)) && half / 2 < bytes.size()) {
                const unsigned byte = bytes[half / 2];
                letter = static_cast<std::uint8_t>(
                    kDigits[half % 2 == 0 ? byte >> kHalfBits : byte & kHalf]);
                ++half;
            }
        }
    }

    void putRaw(Type type, std::span<std::uint8_t> content, const ByteBuffer& from) const {
        std::fill(content.begin(), content.end(), std::uint8_t{0});
        if (type == Type::kData) {
            const ByteBuffer bytes = _replacement.bytes(from, content.size());
            std::copy(bytes.begin(), bytes.end(), content.begin());
        } else if (type == Type::kInteger) {
            putNumber(content, _replacement.number(from, positiveBits(content.size())));
        }
    }

    /// A number of 32 bits or more must stay positive if it is signed.
    static unsigned positiveBits(std::size_t width) {
        constexpr std::size_t kSigned = 4;
        const std::size_t bits = std::min(width, sizeof(std::uint64_t)) * kByteBits;
        return static_cast<unsigned>(width >= kSigned ? bits - 1 : bits);
    }

    /// Big-endian, in the last bytes.
    static void putNumber(std::span<std::uint8_t> content, std::uint64_t number) {
        for (std::size_t at = content.size(); at > 0 && number != 0; --at) {
            content[at - 1] = static_cast<std::uint8_t>(number);
            number >>= kByteBits;
        }
    }

    void replacePlace(const ScalarPlace& place, std::span<std::uint8_t> content) const {
        const Permutation permutation(_places);
        if (place.coding == ScalarPlace::Coding::Letters) {
            const std::string text(content.begin(), content.end());
            const bool isEscaped = text.find_first_of("&<\\") != std::string::npos;
            return put(content, isEscaped ? _places.letters(bytesOf(text), text.size())
                                          : withOtherPlaces(text, permutation));
        }
        if (place.coding == ScalarPlace::Coding::Utf16) {
            return replaceUtf16Place(content, permutation);
        }
        if (place.type != Type::kInteger || content.size() > sizeof(std::uint64_t)) {
            return;
        }
        std::uint64_t number = 0;
        for (const std::uint8_t byte : content) {
            number = number << kByteBits | byte;
        }
        const unsigned width = positiveBits(content.size());
        if (number >> (width - 1) <= 1) { // not negative
            putNumber(content, permutation.of(number, width));
        }
    }

    static void replaceUtf16Place(std::span<std::uint8_t> content, const Permutation& permutation) {
        std::string letters;
        for (std::size_t at = 0; at + 1 < content.size(); at += 2) {
            letters += content[at] == 0 ? static_cast<char>(content[at + 1]) : ' ';
        }
        letters = withOtherPlaces(std::move(letters), permutation);
        for (std::size_t at = 0; at + 1 < content.size(); at += 2) {
            if (content[at] == 0) {
                content[at + 1] = static_cast<std::uint8_t>(letters[at / 2]);
            }
        }
    }

    std::span<std::uint8_t> _list;
    const Replacement& _replacement;
    const Replacement& _places;
};

/// By way of the bytes of a list that holds nothing else.
PropertyList Masker::masked(const PropertyList& value, MaskAction action) const {
    auto alone = serializeBinary(value);
    if (!alone) {
        return value;
    }
    ByteBuffer bytes = *alone;
    (void)scanScalars(*alone, [&](const ScalarVisit& visit) {
        Masker(bytes, _replacement, _places).replace(visit.place, visit.value, action);
    });
    const auto parsed = parsePropertyList(bytes);
    return parsed ? *parsed : value;
}

/// Builds a list anew, with its masked values.
class Rewriting {
public:
    Rewriting(const ScalarRule& rule, const Masker& masker) : _rule(rule), _masker(masker) {}

    PropertyList of(const PropertyList& value) {
        if (const ArrayRef array = value.array()) {
            Array elements;
            _path.emplace_back(kAnyElement);
            for (const PropertyList& element : *array) {
                elements.push_back(of(element));
            }
            _path.pop_back();
            return elements;
        }
        if (const DictionaryRef dictionary = value.dictionary()) {
            Dictionary entries;
            for (const Dictionary::Entry& entry : *dictionary) {
                _path.push_back(entry.key.string());
                entries.set(entry.key, of(entry.value));
                _path.pop_back();
            }
            return entries;
        }
        const MaskAction action = value.boolean() ? MaskAction::Keep : _rule(_path, value);
        return action == MaskAction::Keep ? value : _masker.masked(value, action);
    }

private:
    const ScalarRule& _rule;
    const Masker& _masker;
    ScalarPath _path;
};

/// Whether a masked object is also used for something that stays or is masked in another way.
class Sharing {
public:
    void add(const ScalarPlace& place, MaskAction action) {
        _uses.emplace_back(place.content.offset, action);
    }
    bool isMixed() {
        std::sort(_uses.begin(), _uses.end());
        return std::adjacent_find(_uses.begin(), _uses.end(), [](const auto& a, const auto& b) {
                   return a.first == b.first && a.second != b.second;
               }) != _uses.end();
    }

private:
    std::vector<std::pair<std::size_t, MaskAction>> _uses;
};

} // namespace

ListMaskResult maskList(ByteBuffer& list, const ScalarRule& rule, const Replacement& replacement,
                        const Replacement& places) {
    ByteBuffer result = list;
    const Masker masker(result, replacement, places);
    Sharing sharing;
    const auto scan = scanScalars(list, [&](const ScalarVisit& visit) {
        const MaskAction action =
            visit.place.isKey ? MaskAction::Keep : rule(visit.path, visit.value);
        if (visit.place.content.length == 0) {
            return;
        }
        sharing.add(visit.place, action);
        if (action != MaskAction::Keep) {
            masker.replace(visit.place, visit.value, action);
        }
    });
    if (!scan) {
        return ListMaskResult::NotUnderstood;
    }
    if (scan->overlaps || sharing.isMixed()) {
        const auto parsed = parsePropertyList(list);
        const auto written = serializeBinary(Rewriting(rule, masker).of(*parsed));
        if (!written) {
            return ListMaskResult::NotUnderstood;
        }
        list = *written;
        return ListMaskResult::Rewritten;
    }
    for (const ByteRange& range : scan->hidden) {
        masker.blank(range);
    }
    list = std::move(result);
    return ListMaskResult::Masked;
}

bool looksPersonal(const PropertyList& value) {
    const SharedBytes data = value.data();
    return data != nullptr ? !findIdentities(*data).empty()
                           : hasIdentity(value.string().value_or(""));
}

MaskAction ofLooseValue(const ScalarPath& path, const PropertyList& value) {
    const bool isPersonal =
        looksPersonal(value) || std::any_of(path.begin(), path.end(), isPersonalKey);
    return isPersonal ? MaskAction::Mask : MaskAction::Keep;
}

} // namespace pallax
