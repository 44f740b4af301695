#include "masking/IdentityFinder.h"

#include "knowledge/CountryCodes.h"
#include "masking/BitField.h"

#include <algorithm>
#include <array>
#include <functional>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace pallax {

namespace {

using Kind = FoundIdentity::Kind;
using Coding = FoundIdentity::Coding;

constexpr std::size_t kImsiDigits = 15;
constexpr std::size_t kShortIccid = 19;
constexpr std::size_t kLongIccid = 20;
constexpr std::string_view kIccidStart = "89";
constexpr std::size_t kFewestPhoneDigits = 7;
constexpr std::size_t kMostPhoneDigits = 15;
constexpr std::size_t kDistinctDigits = 4; ///< fewer are padding or a pattern

bool isDigit(std::uint8_t byte) {
    return byte >= '0' && byte <= '9';
}

bool isVaried(std::string_view digits) {
    return std::set<char>(digits.begin(), digits.end()).size() >= kDistinctDigits;
}

/// The check of ITU-T E.118 and of an IMEI, over all digits.
bool hasCheckDigit(std::string_view digits) {
    constexpr int kTen = 10;
    int sum = 0;
    bool isDoubled = false;
    for (auto digit = digits.rbegin(); digit != digits.rend(); ++digit) {
        const int value = (*digit - '0') * (isDoubled ? 2 : 1);
        sum += value / kTen + value % kTen;
        isDoubled = !isDoubled;
    }
    return sum % kTen == 0;
}

bool isImsi(std::string_view digits) {
    constexpr std::size_t kCountryDigits = 3;
    return digits.size() == kImsiDigits && isVaried(digits) &&
           !countryCodesOf(digits.substr(0, kCountryDigits)).empty();
}

bool isIccid(std::string_view digits) {
    const bool isLong = digits.size() == kLongIccid;
    if ((!isLong && digits.size() != kShortIccid) || !digits.starts_with(kIccidStart) ||
        !isVaried(digits)) {
        return false;
    }
    // A card's number of 19 digits may be followed by one more.
    return hasCheckDigit(digits) || (isLong && hasCheckDigit(digits.substr(0, kShortIccid)));
}

/// What a number of these digits is; a phone number only if it begins with "+".
std::optional<Kind> kindOf(std::string_view digits, bool hasPlus) {
    if (hasPlus) {
        const bool isPhone = digits.size() >= kFewestPhoneDigits &&
                             digits.size() <= kMostPhoneDigits && digits.front() != '0' &&
                             isVaried(digits);
        return isPhone ? std::optional(Kind::Phone) : std::nullopt;
    }
    if (isImsi(digits)) {
        return Kind::Imsi;
    }
    if (digits.size() == kImsiDigits && isVaried(digits) && hasCheckDigit(digits)) {
        return Kind::Imei;
    }
    return isIccid(digits) ? std::optional(Kind::Iccid) : std::nullopt;
}

/// Digits in groups, with one blank or dash between them.
struct Groups {
    std::string digits;
    std::vector<std::size_t> sizes{0};
    std::size_t end = 0; ///< behind the last digit
};

Groups groupsAt(Bytes bytes, std::size_t begin, std::size_t stride) {
    Groups groups;
    for (std::size_t at = begin; at < bytes.size(); at += stride) {
        const bool isLetter = stride == 1 || at == begin || bytes[at - 1] == 0;
        if (isLetter && isDigit(bytes[at]) && groups.digits.size() <= kMostPhoneDigits) {
            groups.digits += static_cast<char>(bytes[at]);
            ++groups.sizes.back();
            groups.end = at + 1;
        } else if (isLetter && (bytes[at] == ' ' || bytes[at] == '-') && groups.sizes.back() > 0) {
            groups.sizes.push_back(0);
        } else {
            break;
        }
    }
    if (groups.sizes.back() == 0) {
        groups.sizes.pop_back();
    }
    return groups;
}

/// Written as people write it: a phone number in groups of any size, an IMEI in its own.
std::optional<Kind> kindOf(const Groups& groups, bool hasPlus) {
    using Sizes = std::vector<std::size_t>;
    static const std::array<Sizes, 3> imei{Sizes{2, 6, 6, 1}, Sizes{6, 2, 6, 1}, Sizes{8, 6, 1}};
    const bool isImei = std::find(imei.begin(), imei.end(), groups.sizes) != imei.end();
    if (hasPlus) {
        return kindOf(groups.digits, true);
    }
    return isImei && isVaried(groups.digits) && hasCheckDigit(groups.digits)
               ? std::optional(Kind::Imei)
               : std::nullopt;
}

/// Looks for digits in letters of one or two bytes.
void findLetters(Bytes bytes, std::size_t stride, std::vector<FoundIdentity>& found) {
    // Of letters of two bytes, the other byte of the last one may be followed by anything.
    const auto follows = [&](std::size_t at) {
        return at >= stride && isDigit(bytes[at - stride]) && (stride == 1 || bytes[at - 1] == 0);
    };
    for (std::size_t at = 0; at < bytes.size(); ++at) {
        if (!isDigit(bytes[at]) || follows(at)) {
            continue;
        }
        std::string digits(1, static_cast<char>(bytes[at]));
        std::size_t end = at + stride;
        for (; end < bytes.size() && isDigit(bytes[end]) && follows(end); end += stride) {
            digits += static_cast<char>(bytes[end]);
        }
        end -= stride - 1;
        const bool hasPlus =
            at >= stride && bytes[at - stride] == '+' && (stride == 1 || bytes[at - 1] == 0);
        auto kind = kindOf(digits, hasPlus);
        if (!kind) {
            const Groups groups = groupsAt(bytes, at, stride);
            kind = kindOf(groups, hasPlus);
            end = groups.end;
        }
        if (kind) {
            const std::size_t begin = at - (hasPlus ? stride : 0);
            found.push_back(
                {begin, end - begin, *kind, stride == 1 ? Coding::Text : Coding::Utf16});
        }
    }
}

constexpr std::uint8_t kLastDigit = 9;

/// The digits in halves of bytes, the low half first if `isSwapped`, up to something else; a filler
/// 0xF may end them.
std::string packedDigits(Bytes bytes, bool isSwapped, std::size_t most) {
    std::string digits;
    for (const std::uint8_t byte : bytes) {
        const std::uint8_t high = static_cast<std::uint8_t>(byte >> kHalfBits);
        const std::uint8_t low = byte & kHalf;
        for (const std::uint8_t half : {isSwapped ? low : high, isSwapped ? high : low}) {
            if (half > kLastDigit || digits.size() == most) {
                return digits;
            }
            digits += static_cast<char>('0' + half);
        }
    }
    return digits;
}

/// Whether bytes are more likely to be something else: the ascending offsets of objects in a
/// property list, or small numbers with zeros between them.
bool areOtherNumbers(Bytes bytes) {
    constexpr std::ptrdiff_t kMostZeros = 2;
    constexpr std::size_t kDistinctBytes = 6;
    return std::adjacent_find(bytes.begin(), bytes.end(), std::greater_equal<>()) == bytes.end() ||
           std::count(bytes.begin(), bytes.end(), 0) > kMostZeros ||
           std::set<std::uint8_t>(bytes.begin(), bytes.end()).size() < kDistinctBytes;
}

/// A mobile identity: length 8, then the first digit, whose low half tells the type and that the
/// number of digits is odd.
std::optional<Kind> mobileIdentity(Bytes bytes) {
    constexpr std::uint8_t kLength = 8;
    constexpr std::uint8_t kOddImsi = 0x9;
    constexpr std::uint8_t kOddImei = 0xA;
    if (bytes.size() <= kLength || bytes[0] != kLength || (bytes[1] >> kHalfBits) > kLastDigit) {
        return std::nullopt;
    }
    const std::uint8_t type = bytes[1] & kHalf;
    const std::string digits = static_cast<char>('0' + (bytes[1] >> kHalfBits)) +
                               packedDigits(bytes.subspan(2, kLength - 1), true, kImsiDigits);
    if (type == kOddImsi && isImsi(digits)) {
        return Kind::Imsi;
    }
    const bool isImei = type == kOddImei && digits.size() == kImsiDigits && isVaried(digits) &&
                        hasCheckDigit(digits) &&
                        !areOtherNumbers(bytes.first(kLength + std::size_t{1}));
    return isImei ? std::optional(Kind::Imei) : std::nullopt;
}

/// A dialling number: its length in bytes with the type, which is "international", and the digits.
std::size_t diallingNumber(Bytes bytes) {
    constexpr std::uint8_t kInternational = 0x91;
    constexpr std::uint8_t kLongest = 9;
    constexpr std::uint8_t kShortest = 6;
    if (bytes.size() < 2 || bytes[0] < kShortest || bytes[0] > kLongest ||
        bytes[1] != kInternational || bytes.size() < std::size_t{bytes[0]} + 1) {
        return 0;
    }
    const Bytes packed = bytes.subspan(2, bytes[0] - std::size_t{1});
    const std::string digits = packedDigits(packed, true, 2 * packed.size());
    // All digits but a filler that makes their number even.
    const bool isWhole =
        digits.size() == 2 * packed.size() ||
        (digits.size() + 1 == 2 * packed.size() && packed.back() >> kHalfBits == kHalf);
    return isWhole && kindOf(digits, true) ? std::size_t{bytes[0]} + 1 : 0;
}

bool isPackedIccid(Bytes bytes) {
    constexpr std::size_t kBytes = kLongIccid / 2;
    if (bytes.size() < kBytes) {
        return false;
    }
    const Bytes packed = bytes.first(kBytes);
    return !areOtherNumbers(packed) && (isIccid(packedDigits(packed, true, kLongIccid)) ||
                                        isIccid(packedDigits(packed, false, kLongIccid)));
}

void findPacked(Bytes bytes, std::vector<FoundIdentity>& found) {
    constexpr std::size_t kMobileIdentity = 9;
    constexpr std::size_t kIccidBytes = kLongIccid / 2;
    constexpr std::uint8_t kSwappedStart = 0x98;
    constexpr std::uint8_t kPlainStart = 0x89;
    for (std::size_t at = 0; at < bytes.size(); ++at) {
        const Bytes rest = bytes.subspan(at);
        if (const auto kind = mobileIdentity(rest)) {
            found.push_back({at, kMobileIdentity, *kind, Coding::Bcd});
        } else if (const std::size_t length = diallingNumber(rest); length > 0) {
            found.push_back({at, length, Kind::Phone, Coding::Bcd});
        } else if ((rest[0] == kSwappedStart || rest[0] == kPlainStart) && isPackedIccid(rest)) {
            found.push_back({at, kIccidBytes, Kind::Iccid, Coding::Bcd});
        }
    }
}

} // namespace

std::string_view nameOf(FoundIdentity::Kind kind) {
    switch (kind) {
    case Kind::Imsi:
        return "IMSI";
    case Kind::Imei:
        return "IMEI";
    case Kind::Iccid:
        return "ICCID";
    case Kind::Phone:
        break;
    }
    return "phone number";
}

std::string_view nameOf(FoundIdentity::Coding coding) {
    switch (coding) {
    case Coding::Text:
        return "text";
    case Coding::Utf16:
        return "UTF-16";
    case Coding::Bcd:
        break;
    }
    return "packed digits";
}

std::vector<FoundIdentity> findIdentities(Bytes bytes) {
    std::vector<FoundIdentity> found;
    findLetters(bytes, 1, found);
    findLetters(bytes, 2, found);
    findPacked(bytes, found);
    std::stable_sort(
        found.begin(), found.end(),
        [](const FoundIdentity& a, const FoundIdentity& b) { return a.offset < b.offset; });
    return found;
}

bool hasIdentity(std::string_view text) {
    const auto digits = std::count_if(text.begin(), text.end(), [](char letter) {
        return isDigit(static_cast<std::uint8_t>(letter));
    });
    if (digits < static_cast<std::ptrdiff_t>(kFewestPhoneDigits)) {
        return false; // all kinds have more
    }
    std::vector<FoundIdentity> found;
    findLetters(Bytes(reinterpret_cast<const std::uint8_t*>(text.data()), text.size()), // NOLINT
                1, found);
    return !found.empty();
}

} // namespace pallax
