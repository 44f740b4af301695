#include "web/JsonMembers.h"

#include "decoding/DisplayJson.h"

#include <algorithm>

namespace pallax {

JsonMembers::JsonMembers(const Dictionary& object) {
    for (const Dictionary::Entry& entry : object) {
        std::string json;
        appendJson(json, entry.value);
        _members.emplace_back(std::string(entry.key.view()), std::move(json));
    }
}

std::string JsonMembers::all() const {
    return changedSince({});
}

std::string JsonMembers::changedSince(const JsonMembers& before) const {
    std::string object = "{";
    for (const auto& member : _members) {
        const auto& old = before._members;
        if (std::find(old.begin(), old.end(), member) == old.end()) {
            object += object.size() > 1 ? "," : "";
            appendJsonString(object, member.first);
            object += ':' + member.second;
        }
    }
    return object + '}';
}

} // namespace pallax
