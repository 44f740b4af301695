#pragma once

#include "tests/doubles/Property.h"
#include "tests/simulator/SimulatedPhone.h"

#include <algorithm>
#include <string>
#include <vector>

/// Random values for an encoder, with their display.
namespace pallax {

inline unsigned below(unsigned bound) {
    return static_cast<unsigned>(doubles::any::between(0, static_cast<int>(bound)));
}
inline int between(int least, int bound) {
    return doubles::any::between(least, bound);
}
/// A level that a record can represent: `least` plus `count` steps.
inline double onGrid(double least, double step, unsigned count) {
    return least + step * below(count);
}
inline std::string text(unsigned number) {
    return std::to_string(number);
}

/// Whether all of `expected` is shown: the keys of a dictionary, which may have others that no
/// encoder fills, and the entries of a list.
inline bool shows(const PropertyList& shown, const PropertyList& expected) {
    if (const DictionaryRef keys = expected.dictionary()) {
        const DictionaryRef in = shown.dictionary();
        return in != nullptr &&
               std::all_of(keys->begin(), keys->end(), [&](const Dictionary::Entry& each) {
                   const PropertyList* value = in->find(each.key.view());
                   return value != nullptr && shows(*value, each.value);
               });
    }
    if (const ArrayRef list = expected.array()) {
        const ArrayRef in = shown.array();
        return in != nullptr &&
               std::equal(in->begin(), in->end(), list->begin(), list->end(), shows);
    }
    return shown == expected;
}

/// One of a record's labels with its number.
template <class Number = unsigned>
struct Labelled {
    Number number;
    std::string label;
};
template <class Number>
Labelled<Number> oneOf(const std::vector<Labelled<Number>>& all) {
    return all[below(static_cast<unsigned>(all.size()))];
}

/// The technology's display after the record of `value`.
template <class Value>
void feedEncoded(DecodedDisplay& decoded, const Value& value) {
    ByteBuffer bytes;
    encode(value, bytes); // found in the namespace of the value
    decoded.feed(bytes);
}

} // namespace pallax
