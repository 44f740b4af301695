#include "plist/BinaryPropertyListFormat.h"
#include "plist/Refusal.h"
#include "plist/ScalarPlaces.h"
#include "text/ByteReader.h"
#include "text/Bytes.h"

#include <algorithm>
#include <string_view>

namespace pallax {

namespace {

using namespace binary_form;

/// An object of a list that its reader has accepted.
struct Object {
    std::uint8_t kind = 0;
    std::uint64_t count = 0;
    ByteRange content;
};

class BinaryScan {
public:
    BinaryScan(Bytes bytes, const ScalarVisitor& visitor)
        : _bytes(bytes), _reader(bytes), _visitor(visitor), _layout(readLayout(bytes)),
          _owner(_layout.table, 0) {}

    ScalarScan run() {
        value(offsetOf(_layout.root));
        addHidden();
        return std::move(_scan);
    }

private:
    std::uint64_t number(std::uint64_t offset, std::size_t width) const {
        const auto read = _reader.number(offset, width);
        return read ? *read
                    : (refuse(static_cast<std::size_t>(offset), "a number past the end"), 0);
    }

    std::size_t offsetOf(std::uint64_t reference) const {
        return static_cast<std::size_t>(
            number(_layout.table + reference * _layout.offsetWidth, _layout.offsetWidth));
    }

    std::size_t referenced(const Object& object, std::uint64_t index) const {
        return offsetOf(
            number(object.content.offset + index * _layout.referenceWidth, _layout.referenceWidth));
    }

    Object objectAt(std::size_t offset) const {
        Object object;
        const std::uint64_t marker = number(offset, 1);
        constexpr unsigned kHalf = 4;
        object.kind = static_cast<std::uint8_t>(marker >> kHalf);
        object.count = marker & 0xFU;
        std::size_t start = offset + 1;
        const bool isCounted = object.kind >= kData && object.kind != kUid;
        if (isCounted && object.count == kCountFollows) {
            const std::size_t width = std::size_t{1} << (number(start, 1) & 0xFU);
            object.count = number(start + 1, width);
            start += 1 + width;
        }
        object.content = {start, static_cast<std::size_t>(lengthOf(object))};
        return object;
    }

    std::uint64_t lengthOf(const Object& object) const {
        switch (object.kind) {
        case kSingleton:
            return 0;
        case kInteger:
        case kReal:
        case kDate:
            return std::uint64_t{1} << object.count;
        case kUtf16:
            return 2 * object.count;
        case kArray:
            return object.count * _layout.referenceWidth;
        case kDictionary:
            return 2 * object.count * _layout.referenceWidth;
        default:
            return object.count;
        }
    }

    /// Notes the bytes of an object, and whether they belong to another one too.
    void own(std::size_t offset, const Object& object) {
        const std::size_t end = object.content.offset + object.content.length;
        if (_owner.at(offset) == offset) {
            return;
        }
        for (std::size_t at = offset; at < std::min(end, _owner.size()); ++at) {
            _scan.overlaps = _scan.overlaps || _owner[at] != 0;
            _owner[at] = static_cast<std::uint32_t>(offset);
        }
    }

    void value(std::size_t offset) {
        const Object object = objectAt(offset);
        own(offset, object);
        if (object.kind == kArray) {
            _path.emplace_back(kAnyElement);
            for (std::uint64_t index = 0; index < object.count; ++index) {
                value(referenced(object, index));
            }
            _path.pop_back();
        } else if (object.kind == kDictionary) {
            for (std::uint64_t index = 0; index < object.count; ++index) {
                _path.push_back(key(referenced(object, index)));
                value(referenced(object, object.count + index));
                _path.pop_back();
            }
        } else {
            scalar(object, false);
        }
    }

    /// The name of a key; that of a key that is no string is empty.
    std::string key(std::size_t offset) {
        const Object object = objectAt(offset);
        own(offset, object);
        return scalar(object, true).string().value_or("");
    }

    PropertyList scalar(const Object& object, bool isKey) {
        using Coding = ScalarPlace::Coding;
        if (object.kind == kSingleton) {
            return {};
        }
        PropertyList value = valueOf(object);
        const bool isText = object.kind == kAscii || object.kind == kUtf8;
        const Coding coding = isText                  ? Coding::Letters
                              : object.kind == kUtf16 ? Coding::Utf16
                                                      : Coding::Raw;
        _visitor({_path, {value.type(), coding, object.content, isKey}, value});
        return value;
    }

    /// Read by the reader, from a list of this object alone.
    PropertyList valueOf(const Object& object) const {
        const Bytes content = _bytes.subspan(object.content.offset, object.content.length);
        if (object.kind == kAscii || object.kind == kUtf8) {
            return Text(std::string_view(reinterpret_cast<const char*>(content.data()), // NOLINT
                                         content.size()));
        }
        if (object.kind == kData) {
            return PropertyList::data({content.begin(), content.end()});
        }
        return readAlone(object, content);
    }

    static PropertyList readAlone(const Object& object, Bytes content) {
        constexpr unsigned kHalf = 4;
        constexpr std::size_t kCountWidth = 8;
        ByteBuffer list(kHeaderSize);
        std::copy_n((std::string(kSignature) + std::string(kVersion)).begin(), kHeaderSize,
                    list.begin());
        const bool isLong = object.count >= kCountFollows;
        const std::uint64_t low = isLong ? kCountFollows : object.count;
        list.push_back(static_cast<std::uint8_t>(unsigned{object.kind} << kHalf | low));
        if (isLong) {
            list.push_back(static_cast<std::uint8_t>(unsigned{kInteger} << kHalf | kEightBytes));
            appendNumber(list, object.count, kCountWidth);
        }
        list.insert(list.end(), content.begin(), content.end());
        const std::size_t table = list.size();
        list.push_back(kHeaderSize); // the only offset
        list.resize(list.size() + kUnusedInTrailer, 0);
        list.push_back(1);
        list.push_back(1);
        appendNumber(list, 1, kCountWidth);
        appendNumber(list, 0, kCountWidth);
        appendNumber(list, table, kCountWidth);
        const auto parsed = parseBinaryPropertyList(list);
        return parsed ? *parsed : PropertyList();
    }

    static void appendNumber(ByteBuffer& list, std::uint64_t number, std::size_t width) {
        for (std::size_t left = width; left > 0; --left) {
            list.push_back(static_cast<std::uint8_t>(number >> ((left - 1) * kByteBits)));
        }
    }

    /// The bytes between the header and the offset table that belong to no object.
    void addHidden() {
        std::size_t at = kHeaderSize;
        while (at < _owner.size()) {
            const auto begin = _owner.begin() + static_cast<std::ptrdiff_t>(at);
            const auto first = std::find(begin, _owner.end(), 0U);
            const auto end =
                std::find_if(first, _owner.end(), [](std::uint32_t owner) { return owner != 0; });
            if (first != end) {
                _scan.hidden.push_back({static_cast<std::size_t>(first - _owner.begin()),
                                        static_cast<std::size_t>(end - first)});
            }
            at = static_cast<std::size_t>(end - _owner.begin());
        }
    }

    Bytes _bytes;
    ByteReader _reader;
    const ScalarVisitor& _visitor;
    Layout _layout;
    std::vector<std::uint32_t> _owner; ///< by offset: the object that a byte belongs to, or 0
    ScalarScan _scan;
    ScalarPath _path;
};

} // namespace

ScalarScan scanBinaryScalars(Bytes bytes, const ScalarVisitor& visitor) {
    return BinaryScan(bytes, visitor).run();
}

} // namespace pallax
