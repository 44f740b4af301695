#pragma once

#include "text/Bytes.h"
#include "text/Date.h"
#include "text/NumberFormat.h"
#include "text/Text.h"

#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <variant>
#include <vector>

namespace pallax {

class PropertyList;
class Dictionary;

using Array = std::vector<PropertyList>;
using ArrayRef = std::shared_ptr<Array>;
using DictionaryRef = std::shared_ptr<Dictionary>;

/// The value type of the whole system: commands, templates, displays, state, injected records and
/// snapshot files.
///
/// Copies share arrays and dictionaries: a change to a container is visible through both copies. A
/// string may be a display number (a number with its format), which readers see as an ordinary
/// string; its text is formatted on demand.
class PropertyList {
public:
    // Prefixed with "k" because the plain names are types.
    enum class Type {
        kNull,
        kString,
        kInteger,
        kReal,
        kBoolean,
        kData,
        kDate,
        kArray,
        kDictionary
    };

    PropertyList() = default;
    // Not inline: the variant's code for ten types is large, and every file copies some.
    PropertyList(const PropertyList& other);
    PropertyList(PropertyList&& other) noexcept;
    PropertyList& operator=(const PropertyList& other);
    PropertyList& operator=(PropertyList&& other) noexcept;
    ~PropertyList();
    PropertyList(Text text) : _value(std::move(text)) {}
    PropertyList(std::string text) : _value(Text(std::move(text))) {}
    PropertyList(const char* text) : _value(Text(text)) {}
    PropertyList(DisplayNumber number) : _value(number) {}
    PropertyList(SharedBytes data) : _value(std::move(data)) {}
    PropertyList(Date date) : _value(date) {}
    PropertyList(ArrayRef array) : _value(std::move(array)) {}
    PropertyList(DictionaryRef dictionary) : _value(std::move(dictionary)) {}
    PropertyList(Array elements);
    PropertyList(Dictionary entries);

    static PropertyList integer(std::int64_t number) { return PropertyList(Value(number)); }
    static PropertyList unsignedInteger(std::uint64_t number);
    static PropertyList real(double number) { return PropertyList(Value(number)); }
    static PropertyList boolean(bool truth) { return PropertyList(Value(truth)); }
    static PropertyList data(ByteBuffer bytes);

    Type type() const;
    /// The type's name in diagnostics: "string", "integer", "dictionary", …
    std::string_view typeName() const;
    bool isNull() const { return type() == Type::kNull; }
    bool isString() const { return type() == Type::kString; }

    /// The text of a string; nothing for any other type.
    std::optional<std::string> string() const;
    /// Appends the text of a string; false (and nothing appended) for any other type.
    bool appendString(std::string& out) const;
    /// The text of a string that is not a display number, otherwise null.
    const Text* text() const { return std::get_if<Text>(&_value); }
    /// The number of a display string, otherwise null.
    const DisplayNumber* displayNumber() const { return std::get_if<DisplayNumber>(&_value); }

    std::optional<std::int64_t> integer() const { return get<std::int64_t>(); }
    /// An integer that only fits unsigned 64 bits; nothing for any other value.
    std::optional<std::uint64_t> largeInteger() const { return get<std::uint64_t>(); }
    std::optional<double> real() const { return get<double>(); }
    std::optional<bool> boolean() const { return get<bool>(); }
    std::optional<Date> date() const { return get<Date>(); }
    SharedBytes data() const; ///< null if this is not a data value
    /// Null if this is not an array.
    ArrayRef array() const {
        const auto* array = std::get_if<ArrayRef>(&_value);
        return array != nullptr ? *array : nullptr;
    }
    /// Null if this is not a dictionary.
    DictionaryRef dictionary() const {
        const auto* dictionary = std::get_if<DictionaryRef>(&_value);
        return dictionary != nullptr ? *dictionary : nullptr;
    }

    /// Assigns the value; at the cost of a plain copy if the kind is the same.
    void assign(const DisplayNumber& number) { _value = number; }
    void assign(Text text) { _value = std::move(text); }

    /// The number as a signed 32-bit integer: an integer in range, or a real with a whole value in
    /// range; otherwise nothing. Strings are not converted.
    std::optional<std::int32_t> int32() const;

    /// A one-level copy: a new container that shares its elements; any other value itself.
    PropertyList shallowCopy() const;

    /// One readable line for log texts: { key = value; }, ( a, b ), <01ff>.
    std::string description() const;

    /// The property-list equality: same type and same content at every depth; strings by their
    /// text, dictionaries in any order.
    friend bool operator==(const PropertyList& a, const PropertyList& b);

private:
    using Value = std::variant<std::monostate, Text, DisplayNumber, std::int64_t, double, bool,
                               SharedBytes, Date, ArrayRef, DictionaryRef, std::uint64_t>;
    explicit PropertyList(Value value) : _value(std::move(value)) {}

    template <class T>
    std::optional<T> get() const {
        const T* value = std::get_if<T>(&_value);
        return value != nullptr ? std::optional<T>(*value) : std::nullopt;
    }

    Value _value;
};

/// A map from string keys to values that keeps the order in which the keys were first set.
class Dictionary {
public:
    struct Entry {
        Entry(Text entryKey, PropertyList entryValue, bool isStringKey = true)
            : key(std::move(entryKey)), value(std::move(entryValue)), hasStringKey(isStringKey) {}

        Text key;
        PropertyList value;
        /// False for an entry whose key was not a string in the source (`key` is its printed form):
        /// lookups do not find it, only iteration.
        bool hasStringKey;
    };

    Dictionary() = default;
    Dictionary(const Dictionary& other);
    Dictionary(Dictionary&& other) noexcept;
    Dictionary& operator=(const Dictionary& other);
    Dictionary& operator=(Dictionary&& other) noexcept;
    ~Dictionary();
    Dictionary(std::initializer_list<std::pair<const char*, PropertyList>> entries);

    /// The value under `key`, or null. The pointer is valid until the next change.
    const PropertyList* find(std::string_view key) const;
    bool contains(std::string_view key) const { return find(key) != nullptr; }

    /// Replaces the value under `key` in place, or appends.
    void set(Text key, PropertyList value);
    /// The same for a key with static storage duration; allocates no key.
    void setFixed(std::string_view key, PropertyList value) { valueToSet(key) = std::move(value); }
    /// The value under a key with static storage duration, appended as null if missing. Valid until
    /// the next change.
    PropertyList& valueToSet(std::string_view key) {
        return _next < _entries.size() && isAt(_next, key) ? _entries[_next++].value
                                                           : searchedOrAppended(key);
    }
    /// For a dictionary that is filled again from its start: the value under the key that follows
    /// the one set last. Where another key follows, it and all after it are removed.
    PropertyList& valueInOrder(std::string_view key) {
        return _next < _entries.size() && isAt(_next, key) ? _entries[_next++].value
                                                           : appendedInOrder(key);
    }
    void startOver() { _next = 0; }
    /// Removes what follows the key set last.
    void dropRest() { truncate(_next); }
    void appendForeignKey(const PropertyList& key, PropertyList value);
    /// True if the key was there.
    bool remove(std::string_view key);

    void reserve(std::size_t count) { _entries.reserve(count); }
    /// Removes all entries but the first `count` and keeps their memory. The search for the next
    /// key starts at the first entry.
    void truncate(std::size_t count);
    std::size_t size() const { return _entries.size(); }
    bool empty() const { return _entries.empty(); }
    auto begin() const { return _entries.begin(); }
    auto end() const { return _entries.end(); }

private:
    static constexpr std::size_t kNotFound = static_cast<std::size_t>(-1);
    /// The views point into the entries' keys.
    using Index = std::unordered_map<std::string_view, std::size_t>;

    /// A key from a table usually is the text set before; an equal address saves comparing the
    /// texts.
    bool isAt(std::size_t at, std::string_view key) const {
        const Entry& entry = _entries[at];
        const std::string_view there = entry.key.view();
        return there.size() == key.size() && (there.data() == key.data() || there == key) &&
               entry.hasStringKey;
    }
    std::size_t indexOf(std::string_view key) const;
    PropertyList& searchedOrAppended(std::string_view key);
    PropertyList& appendedInOrder(std::string_view key);
    void append(Text key, PropertyList value, bool isStringKey);
    void rebuildIndex();

    std::vector<Entry> _entries;
    /// Built once a linear search would be slow; null before.
    std::unique_ptr<Index> _index;
    /// The entry after the last one set. Callers that set many keys use the same order each time,
    /// so the next key is usually found here, without a search.
    std::size_t _next = 0;
};

} // namespace pallax
