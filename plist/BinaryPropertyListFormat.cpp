#include "plist/BinaryPropertyListFormat.h"

#include "plist/Refusal.h"
#include "text/ByteReader.h"

#include <string>

namespace pallax::binary_form {

namespace {

// Offsets in the trailer.
constexpr std::size_t kOffsetWidthAt = 6;
constexpr std::size_t kReferenceWidthAt = 7;
constexpr std::size_t kObjectCountAt = 8;
constexpr std::size_t kRootAt = 16;
constexpr std::size_t kTableAt = 24;

void requireHeader(Bytes bytes) {
    const auto holds = [&](std::size_t offset, std::string_view wanted) {
        const auto found = ByteReader(bytes).bytes(offset, wanted.size());
        return found && std::string(found->begin(), found->end()) == wanted;
    };
    if (!holds(0, kSignature)) {
        refuse(0, "no binary property list");
    }
    if (!holds(kSignature.size(), kVersion)) {
        refuse(kSignature.size(), "a binary form other than version 00");
    }
    if (bytes.size() < kHeaderSize + kTrailerSize) {
        refuse(bytes.size(), "a binary property list without its trailer");
    }
}

} // namespace

Layout readLayout(Bytes bytes) {
    requireHeader(bytes);
    const std::size_t start = bytes.size() - kTrailerSize;
    const ByteReader trailer(bytes.subspan(start));
    Layout layout;
    layout.offsetWidth = static_cast<std::size_t>(*trailer.number(kOffsetWidthAt, 1));
    layout.referenceWidth = static_cast<std::size_t>(*trailer.number(kReferenceWidthAt, 1));
    layout.objectCount = *trailer.number(kObjectCountAt, kWidestNumber);
    layout.root = *trailer.number(kRootAt, kWidestNumber);
    layout.table = *trailer.number(kTableAt, kWidestNumber);
    if (layout.offsetWidth == 0 || layout.offsetWidth > kWidestNumber) {
        refuse(start + kOffsetWidthAt, "an offset width other than 1 to 8 bytes");
    }
    if (layout.referenceWidth == 0 || layout.referenceWidth > kWidestNumber) {
        refuse(start + kReferenceWidthAt, "a reference width other than 1 to 8 bytes");
    }
    if (layout.table <= kHeaderSize || layout.table > start) {
        refuse(start + kTableAt, "an offset table outside the file");
    }
    const std::uint64_t tableSize = start - layout.table;
    if (layout.objectCount == 0 || layout.objectCount > tableSize ||
        layout.objectCount * layout.offsetWidth != tableSize) {
        refuse(start + kObjectCountAt, "a number of objects that does not fit the offset table");
    }
    if (layout.root >= layout.objectCount) {
        refuse(start + kRootAt, "a root object outside the object table");
    }
    return layout;
}

} // namespace pallax::binary_form
