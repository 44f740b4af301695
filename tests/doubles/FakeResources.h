#pragma once

#include "platform/Resources.h"

#include <map>
#include <utility>

namespace pallax::doubles {

/// Resources in memory: a property list for each added name, with the path "resources/NAME.plist".
class FakeResources final : public Resources {
public:
    void add(const std::string& name, PropertyList object) { _objects[name] = std::move(object); }

    std::optional<PropertyList> propertyList(std::string_view name) const override {
        const auto found = _objects.find(name);
        return found != _objects.end() ? std::optional(found->second) : std::nullopt;
    }
    std::vector<std::string> propertyListPaths() const override {
        std::vector<std::string> paths;
        paths.reserve(_objects.size());
        for (const auto& [name, object] : _objects) {
            paths.push_back("resources/" + name + ".plist");
        }
        return paths;
    }

private:
    std::map<std::string, PropertyList, std::less<>> _objects;
};

} // namespace pallax::doubles
