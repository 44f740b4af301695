#pragma once

#include "plist/PropertyList.h"

#include <algorithm>

namespace pallax::doubles {

/// Equal values with equal order of keys. Dictionaries are equal in any order.
inline bool sameInOrder(const Dictionary& a, const Dictionary& b) {
    return std::equal(a.begin(), a.end(), b.begin(), b.end(),
                      [](const Dictionary::Entry& one, const Dictionary::Entry& other) {
                          return one.key == other.key && one.value == other.value;
                      });
}

} // namespace pallax::doubles
