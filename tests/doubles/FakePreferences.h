#pragma once

#include "platform/Preferences.h"

#include <map>
#include <string>
#include <vector>

namespace pallax::doubles {

/// Preferences in memory, with a diary of the calls.
class FakePreferences final : public Preferences {
public:
    bool failSynchronize = false;
    std::vector<std::string> diary; ///< "set DOMAIN KEY", "synchronize DOMAIN", "post DOMAIN KEY"

    void setValue(std::string_view key, const PropertyList& value,
                  std::string_view domain) override {
        diary.push_back("set " + std::string(domain) + " " + std::string(key));
        _domains[std::string(domain)].set(Text(key), value);
    }
    bool synchronize(std::string_view domain) override {
        diary.push_back("synchronize " + std::string(domain));
        return !failSynchronize;
    }
    void postChangedNotice(std::string_view domain, std::string_view key) override {
        diary.push_back("post " + std::string(domain) + " " + std::string(key));
    }

    /// The values of a domain.
    Dictionary domain(const std::string& name) const {
        const auto found = _domains.find(name);
        return found != _domains.end() ? found->second : Dictionary();
    }

private:
    std::map<std::string, Dictionary> _domains;
};

} // namespace pallax::doubles
