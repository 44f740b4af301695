#pragma once

#include "plist/PropertyList.h"

#include <string>
#include <utility>
#include <vector>

namespace pallax {

/// The members of an object as JSON, to tell which of them have changed.
class JsonMembers {
public:
    JsonMembers() = default;
    explicit JsonMembers(const Dictionary& object);

    /// {"head":{…},"cells":[…]}
    std::string all() const;
    /// The same with only those members that differ from those before, or are new.
    std::string changedSince(const JsonMembers& before) const;
    friend bool operator==(const JsonMembers&, const JsonMembers&) = default;

private:
    std::vector<std::pair<std::string, std::string>> _members;
};

} // namespace pallax
