#pragma once

#include "LogGenerator/KeyFrame.h"
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
/// "/Serving Cell/ARFCN", and is numbered when a message first contains it. A list's key is its
/// path. Entries share their paths, with "*" in place of an index: "/Neighbour Cells/*/ARFCN".
class ObjectSamples {
public:
    /// The limit for values and lists; further paths are left out, because messages may contain any
    /// number.
    static constexpr std::size_t kMostPaths = 4096;

    /// Gives the content of the object's display form to the sink. A path of the previous object
    /// that this one lacks is a removed key. The object's types must have been checked.
    void give(const PropertyList& object, SampleSink& sink);

    KeyFrame::Paths paths() const;
    /// Goes on after another's message: the same paths have the same numbers.
    void resume(const KeyFrame::Paths& paths);

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
    /// The number of the current path, or kNoField when there are too many.
    FieldId take();
    FieldId add(std::string_view path);
    void removeOthers(const std::vector<FieldId>& before);

    std::unordered_map<std::string, FieldId, Hash, std::equal_to<>> _ids;
    std::deque<Field> _fields; ///< by number; `_ids` owns the keys
    /// By the number of a path plus 1, the path that followed it last; at 0, the first path.
    std::vector<FieldId> _after = {kNoField};
    std::vector<FieldId> _shown; ///< outside lists, in the latest object

    // While an object is walked:
    SampleSink* _sink = nullptr;
    std::string _path;
    std::size_t _lists = 0;  ///< open lists
    std::size_t _latest = 0; ///< place in `_after`
};

} // namespace pallax
