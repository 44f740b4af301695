#include "plist/PropertyList.h"

#include "text/Format.h"

#include <array>
#include <cmath>
#include <limits>

namespace pallax {

namespace {

// With fewer entries a linear search beats hashing; sections have at most about 20.
constexpr std::size_t kIndexedFrom = 24;

bool equalStrings(const PropertyList& a, const PropertyList& b) {
    const DisplayNumber* left = a.displayNumber();
    const DisplayNumber* right = b.displayNumber();
    if (left != nullptr && right != nullptr && left->sameNumberAndFormat(*right)) {
        return true;
    }
    return a.string() == b.string();
}

bool equalDictionaries(const Dictionary& a, const Dictionary& b) {
    if (a.size() != b.size()) {
        return false;
    }
    for (const Dictionary::Entry& entry : a) {
        const PropertyList* other = entry.hasStringKey ? b.find(entry.key.view()) : nullptr;
        if (other == nullptr || !(entry.value == *other)) {
            return false;
        }
    }
    return true;
}

template <class Container, class Append>
void describeAll(std::string& out, const Container& container, std::string_view open,
                 std::string_view close, const Append& append) {
    out += open;
    bool first = true;
    for (const auto& element : container) {
        out += first ? " " : "";
        append(element, first);
        first = false;
    }
    out += first ? "" : " ";
    out += close;
}

void describe(std::string& out, const PropertyList& object) {
    if (object.appendString(out)) {
        return;
    }
    if (const DictionaryRef dictionary = object.dictionary()) {
        describeAll(out, *dictionary, "{", "}", [&](const Dictionary::Entry& entry, bool first) {
            out += first ? "" : " ";
            out += entry.key.view();
            out += " = ";
            describe(out, entry.value);
            out += ';';
        });
    } else if (const ArrayRef array = object.array()) {
        describeAll(out, *array, "(", ")", [&](const PropertyList& element, bool first) {
            out += first ? "" : ", ";
            describe(out, element);
        });
    } else if (const SharedBytes data = object.data()) {
        out += dumpOf(data->data(), data->size());
    } else if (const auto date = object.date()) {
        out += dateText(*date);
    } else if (const auto integer = object.integer()) {
        out += std::to_string(*integer);
    } else if (const auto large = object.largeInteger()) {
        out += std::to_string(*large);
    } else if (const auto real = object.real()) {
        out += formatText("%f", {*real});
    } else if (const auto truth = object.boolean()) {
        out += *truth ? "true" : "false";
    } else {
        out += "(null)";
    }
}

} // namespace

PropertyList::PropertyList(const PropertyList& other) = default;
PropertyList::PropertyList(PropertyList&& other) noexcept = default;
PropertyList& PropertyList::operator=(const PropertyList& other) = default;
PropertyList& PropertyList::operator=(PropertyList&& other) noexcept = default;
PropertyList::~PropertyList() = default;

PropertyList::PropertyList(Array elements) : _value(std::make_shared<Array>(std::move(elements))) {}

PropertyList::PropertyList(Dictionary entries)
    : _value(std::make_shared<Dictionary>(std::move(entries))) {}

PropertyList PropertyList::unsignedInteger(std::uint64_t number) {
    constexpr auto kLargestSigned =
        static_cast<std::uint64_t>(std::numeric_limits<std::int64_t>::max());
    return number <= kLargestSigned ? integer(static_cast<std::int64_t>(number))
                                    : PropertyList(Value(number));
}

PropertyList PropertyList::data(ByteBuffer bytes) {
    return {std::make_shared<const ByteBuffer>(std::move(bytes))};
}

PropertyList::Type PropertyList::type() const {
    constexpr std::array kTypes = {Type::kNull,  Type::kString,     Type::kString, Type::kInteger,
                                   Type::kReal,  Type::kBoolean,    Type::kData,   Type::kDate,
                                   Type::kArray, Type::kDictionary, Type::kInteger};
    static_assert(kTypes.size() == std::variant_size_v<Value>);
    return kTypes.at(_value.index());
}

std::string_view PropertyList::typeName() const {
    constexpr std::array<std::string_view, 9> kNames = {
        "null", "string", "integer", "real", "boolean", "data", "date", "array", "dictionary"};
    return kNames.at(static_cast<std::size_t>(type()));
}

std::optional<std::string> PropertyList::string() const {
    std::string out;
    return appendString(out) ? std::optional<std::string>(std::move(out)) : std::nullopt;
}

bool PropertyList::appendString(std::string& out) const {
    if (const auto* text = std::get_if<Text>(&_value)) {
        out += text->view();
        return true;
    }
    if (const auto* number = std::get_if<DisplayNumber>(&_value)) {
        number->appendText(out);
        return true;
    }
    return false;
}

SharedBytes PropertyList::data() const {
    const auto* data = std::get_if<SharedBytes>(&_value);
    return data != nullptr ? *data : nullptr;
}

std::optional<std::int32_t> PropertyList::int32() const {
    constexpr auto kLeast = std::numeric_limits<std::int32_t>::min();
    constexpr auto kLargest = std::numeric_limits<std::int32_t>::max();
    if (const auto number = integer()) {
        if (*number >= kLeast && *number <= kLargest) {
            return static_cast<std::int32_t>(*number);
        }
    } else if (const auto whole = real()) {
        if (*whole >= kLeast && *whole <= kLargest && std::trunc(*whole) == *whole) {
            return static_cast<std::int32_t>(*whole);
        }
    }
    return std::nullopt;
}

PropertyList PropertyList::shallowCopy() const {
    if (const ArrayRef elements = array()) {
        return Array(*elements);
    }
    if (const DictionaryRef entries = dictionary()) {
        return Dictionary(*entries);
    }
    return *this;
}

std::string PropertyList::description() const {
    std::string out;
    describe(out, *this);
    return out;
}

bool operator==(const PropertyList& a, const PropertyList& b) {
    if (a.type() != b.type()) {
        return false;
    }
    switch (a.type()) {
    case PropertyList::Type::kString:
        return equalStrings(a, b);
    case PropertyList::Type::kData:
        return *a.data() == *b.data();
    case PropertyList::Type::kArray:
        return *a.array() == *b.array();
    case PropertyList::Type::kDictionary:
        return equalDictionaries(*a.dictionary(), *b.dictionary());
    default:
        return a._value == b._value;
    }
}

Dictionary::~Dictionary() = default;

Dictionary::Dictionary(std::initializer_list<std::pair<const char*, PropertyList>> entries) {
    reserve(entries.size());
    for (const auto& [key, value] : entries) {
        set(key, value);
    }
}

Dictionary::Dictionary(const Dictionary& other) : _entries(other._entries) {
    rebuildIndex();
}

Dictionary::Dictionary(Dictionary&& other) noexcept
    : _entries(std::move(other._entries)), _index(std::move(other._index)) {
    other.truncate(0);
}

Dictionary& Dictionary::operator=(const Dictionary& other) {
    return *this = Dictionary(other);
}

Dictionary& Dictionary::operator=(Dictionary&& other) noexcept {
    _entries.swap(other._entries);
    _index.swap(other._index);
    _next = 0;
    other.truncate(0);
    return *this;
}

void Dictionary::truncate(std::size_t count) {
    if (count < _entries.size()) {
        _entries.erase(_entries.begin() + static_cast<std::ptrdiff_t>(count), _entries.end());
        rebuildIndex();
    }
    _next = 0;
}

std::size_t Dictionary::indexOf(std::string_view key) const {
    if (_index != nullptr) {
        const auto found = _index->find(key);
        return found != _index->end() ? found->second : kNotFound;
    }
    for (std::size_t at = 0; at < _entries.size(); ++at) {
        if (isAt(at, key)) {
            return at;
        }
    }
    return kNotFound;
}

const PropertyList* Dictionary::find(std::string_view key) const {
    const std::size_t at = indexOf(key);
    return at != kNotFound ? &_entries[at].value : nullptr;
}

void Dictionary::append(Text key, PropertyList value, bool isStringKey) {
    _entries.emplace_back(std::move(key), std::move(value), isStringKey);
    if (_entries.size() == kIndexedFrom) {
        rebuildIndex();
    } else if (_index != nullptr && isStringKey) {
        _index->emplace(_entries.back().key.view(), _entries.size() - 1);
    }
}

void Dictionary::set(Text key, PropertyList value) {
    const bool isNext = _next < _entries.size() && isAt(_next, key.view());
    const std::size_t at = isNext ? _next : indexOf(key.view());
    if (at != kNotFound) {
        _entries[at].value = std::move(value);
        _next = at + 1;
    } else {
        append(std::move(key), std::move(value), true);
    }
}

PropertyList& Dictionary::searchedOrAppended(std::string_view key) {
    const std::size_t at = indexOf(key);
    if (at == kNotFound) {
        append(Text::fixed(key), {}, true);
        return _entries.back().value;
    }
    _next = at + 1;
    return _entries[at].value;
}

PropertyList& Dictionary::appendedInOrder(std::string_view key) {
    const std::size_t at = _next;
    truncate(at);
    append(Text::fixed(key), {}, true);
    _next = at + 1;
    return _entries.back().value;
}

void Dictionary::appendForeignKey(const PropertyList& key, PropertyList value) {
    append(key.description(), std::move(value), false);
}

bool Dictionary::remove(std::string_view key) {
    const std::size_t at = indexOf(key);
    if (at == kNotFound) {
        return false;
    }
    _entries.erase(_entries.begin() + static_cast<std::ptrdiff_t>(at));
    rebuildIndex();
    return true;
}

void Dictionary::rebuildIndex() {
    _index.reset();
    if (_entries.size() < kIndexedFrom) {
        return;
    }
    _index = std::make_unique<Index>();
    for (std::size_t at = 0; at < _entries.size(); ++at) {
        if (_entries[at].hasStringKey) {
            _index->emplace(_entries[at].key.view(), at);
        }
    }
}

} // namespace pallax
