#pragma once

#include "plist/PropertyList.h"

#include <cstddef>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The objects of ModemManager, as its signals keep them up to date. What goes beyond the limits is
/// dropped.
class ModemObjects {
public:
    static constexpr std::size_t kMostObjects = 4096;
    static constexpr std::size_t kMostInterfaces = 64;
    static constexpr std::size_t kMostProperties = 256;
    /// Of all names and values together.
    static constexpr std::size_t kMostBytes = 16U << 20;

    /// Takes the answer to GetManagedObjects in place of all that is known.
    void replace(const PropertyList& objects);
    /// `interfaces` are dictionaries of properties by the interface's name.
    void add(const std::string& path, const Dictionary& interfaces);
    /// An object without interfaces is gone, whether the bus says so or not.
    void remove(const std::string& path, const std::vector<std::string>& interfaces);
    /// Only of an object and an interface that are there. True if they are.
    bool change(const std::string& path, const std::string& interface,
                const Dictionary& properties);
    void clear();

    /// The interfaces of an object, or null. Valid until the next change.
    const Dictionary* find(const std::string& path) const;
    /// The paths of all modems, by their index.
    std::vector<std::string> modems() const;
    /// At most kMostBytes.
    std::size_t bytes() const { return _bytes; }

private:
    /// Takes a value in place of that with the key, if there is room.
    void put(Dictionary& values, const Dictionary::Entry& entry);

    std::map<std::string, Dictionary> _objects; ///< by path
    std::size_t _bytes = 0;
};

} // namespace pallax
