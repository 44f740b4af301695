#pragma once

#include "LogGenerator/Records/Sample.h"
#include "plist/PropertyList.h"

#include <cstddef>
#include <deque>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

/// The samples of an object stream. Its objects have no layouts: a field is a path in the display,
/// "/Serving Cell/ARFCN", and gets its number when a message first has it. A list has its path as
/// key; its entries share their paths, with "*" in place of an index: "/Neighbour Cells/*/ARFCN".
class ObjectSamples {
public:
    /// Of values and lists; further ones are left out, for messages may name paths without end.
    static constexpr std::size_t kMostPaths = 4096;

    /// Gives what the display form of the object holds to the sink. A path that the object before
    /// had and this one has not is a removed key. The object's values are of the three types.
    void give(const PropertyList& object, SampleSink& sink);

private:
    struct Hash {
        using is_transparent = void;
        std::size_t operator()(std::string_view path) const {
            return std::hash<std::string_view>()(path);
        }
    };
    static constexpr FieldId kNoField = static_cast<FieldId>(-1);

    void walk(const PropertyList& object);
    void walkCollapsed(const PropertyList& object, std::string_view name);
    void giveText(std::string_view text);
    void giveList(const Array& elements);
    /// The number of the path, or kNoField when there are too many.
    FieldId take();
    void removeOthers(const std::vector<FieldId>& before);

    std::unordered_map<std::string, FieldId, Hash, std::equal_to<>> _ids;
    std::deque<Field> _fields;   ///< by number; keys are those of `_ids`
    std::vector<FieldId> _shown; ///< outside of lists, of the latest object

    // While an object is walked:
    SampleSink* _sink = nullptr;
    std::string _path;
    std::size_t _lists = 0; ///< begun and not ended
};

} // namespace pallax
