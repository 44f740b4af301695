#include "monitor/ValueAges.h"

#include "LogGenerator/SectionAges.h"

#include <algorithm>

namespace pallax {

namespace {

/// The path of the branch above, or an empty one.
std::string_view above(std::string_view path) {
    return path.substr(0, path.rfind('/'));
}

} // namespace

/// A branch without a time of its own is read with the values below it.
void ValueAges::take(const SectionAges& ages) {
    std::map<std::string_view, Time> latest;
    for (const auto& [path, read] : ages.all()) {
        std::string_view each = path;
        do {
            Time& time = latest.try_emplace(each, read).first->second;
            time = std::max(time, read);
            each = above(each);
        } while (!each.empty());
    }
    for (const auto& [path, read] : latest) {
        auto found = _arrivals.find(path);
        if (found == _arrivals.end()) {
            found = _arrivals.emplace(path, Arrivals()).first;
        }
        found->second.note(read);
    }
}

const Arrivals* ValueAges::arrivals(std::string_view path) const {
    for (; !path.empty(); path = above(path)) {
        if (const auto found = _arrivals.find(path); found != _arrivals.end()) {
            return &found->second;
        }
    }
    const auto root = _arrivals.find(std::string_view("/"));
    return root != _arrivals.end() ? &root->second : nullptr;
}

} // namespace pallax
