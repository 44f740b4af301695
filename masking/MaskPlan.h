#pragma once

#include "fields/FieldRegistry.h"
#include "plist/ScalarPlaces.h"

#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_set>
#include <vector>

namespace pallax {

class Resources;

/// Which fields to mask beside those that the registry marks as personal.
struct MaskChoice {
    std::vector<std::string> keep = {}; ///< names of fields or their ends
    std::vector<std::string> also = {};
    bool coarsePlace = false; ///< identities of cells and areas too
    bool keepUnknown = false; ///< what cannot be understood stays as it is
};

enum class MaskAction {
    Keep,
    Place, ///< gets a keyed pseudonym of the same range
    Mask,
};

/// What to do with each field of a technology.
class MaskPlan {
public:
    MaskPlan(const RecordedTechnology& technology, const Resources& resources,
             const MaskChoice& choice);
    ~MaskPlan() = default;
    MaskPlan(const MaskPlan&) = delete; // parts point to each other
    MaskPlan& operator=(const MaskPlan&) = delete;
    MaskPlan(MaskPlan&&) = default;
    MaskPlan& operator=(MaskPlan&&) = default;

    /// Whether messages are property lists, without log codes.
    bool areObjects() const { return _byCode.empty(); }
    /// How the sections read records of that code; empty if none does.
    const std::vector<const CodeDescription*>& codes(LogCode code) const;
    MaskAction of(FieldId row) const;
    /// Whether any field of the code is to be replaced.
    bool masks(const CodeDescription& code) const { return _masked.contains(&code); }
    /// The name of the field of a row.
    const std::string& nameOf(FieldId row) const;

    /// What to do with a value in the payload of a record that is a property list.
    MaskAction ofPayload(const CodeDescription& code, const ScalarPath& path) const;
    /// What to do with a value of the display. The display of an object stream is its message,
    /// in which one-entry dictionaries may stand between the keys.
    MaskAction ofDisplay(const ScalarPath& path) const;

    bool keepsUnknown() const { return _keepsUnknown; }

    /// The first name that no field of any technology has.
    static std::optional<std::string> unknownName(const MaskChoice& choice,
                                                  const Resources& resources);

private:
    struct Row {
        MaskAction action;
        const FieldInfo* field;
    };
    struct Shown {
        std::vector<std::string> path;
        MaskAction action;
        bool isObject; ///< everything below the path belongs to the field
    };

    MaskAction actionOf(const FieldInfo& field, const MaskChoice& choice) const;
    template <class Described>
    bool masksIn(const Described& parts) const; ///< fields, and lists of them

    TechnologyReference _reference;
    FieldRegistry _registry;
    std::map<LogCode, std::vector<const CodeDescription*>> _byCode;
    std::map<FieldId, Row> _rows;
    std::unordered_set<const CodeDescription*> _masked;
    std::vector<Shown> _shown;
    bool _keepsUnknown;
};

/// Whether a key names something that identifies a person, in any technology: "IMSI", "Own Number".
bool isPersonalKey(std::string_view key);

} // namespace pallax
