#pragma once

#include "fields/Reference.h"
#include "host/DirectoryResources.h"
#include "host/Recording.h"

#include <functional>
#include <map>
#include <set>
#include <string>
#include <vector>

namespace pallax::doubles {

/// Maps a section to its keys.
using Keys = std::map<std::string, std::set<std::string>>;

/// The descriptions from the source tree's templates.
inline std::vector<TechnologyReference> reference() {
    return gatherReference(DirectoryResources(PALLAX_SOURCE_DIR "/resources"));
}

/// Calls `see` for every list of a code, including nested ones.
inline void forEachList(const std::vector<ListDescription>& lists,
                        const std::function<void(const ListDescription&)>& see) {
    for (const ListDescription& list : lists) {
        see(list);
        forEachList(list.lists, see);
    }
}

inline void forEachList(const CodeDescription& code,
                        const std::function<void(const ListDescription&)>& see) {
    forEachList(code.lists, see);
    for (const SubpacketDescription& subpacket : code.subpackets) {
        forEachList(subpacket.lists, see);
    }
}

/// The keys that a code shows in its section (or reads without showing).
inline std::set<std::string> keysOf(const CodeDescription& code, bool shown) {
    std::set<std::string> keys;
    const auto add = [&keys](const std::string& key) {
        if (!key.empty()) {
            keys.insert(key);
        }
    };
    const auto addFields = [&add](const std::vector<FieldDescription>& fields) {
        for (const FieldDescription& field : fields) {
            add(field.key);
        }
    };
    if (shown) {
        addFields(code.fields);
        for (const SubpacketDescription& subpacket : code.subpackets) {
            addFields(subpacket.fields);
        }
    }
    forEachList(code, [&](const ListDescription& list) {
        if (list.isShown == shown) {
            add(list.key);
            addFields(list.fields);
        }
    });
    return keys;
}

/// The keys that are described as shown, by section.
inline Keys shownKeys(const TechnologyReference& technology) {
    Keys keys;
    for (const SectionReference& section : technology.sections) {
        std::set<std::string>& itsKeys = keys[section.name];
        for (const ObjectKey& key : section.objectKeys) {
            itsKeys.insert(key.name);
        }
        for (const CodeDescription& code : section.codes) {
            itsKeys.merge(keysOf(code, true));
        }
    }
    return keys;
}

/// The keys that are read but not shown by any code, by section.
inline Keys hiddenKeys(const TechnologyReference& technology) {
    const Keys shown = shownKeys(technology);
    Keys keys;
    for (const SectionReference& section : technology.sections) {
        for (const CodeDescription& code : section.codes) {
            for (const std::string& key : keysOf(code, false)) {
                if (!shown.at(section.name).contains(key)) {
                    keys[section.name].insert(key);
                }
            }
        }
    }
    return keys;
}

} // namespace pallax::doubles
