#pragma once

#include "fields/Description.h"
#include "platform/Resources.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

struct RecordedTechnology;

/// A key of an IFX section, which has no log code.
struct ObjectKey {
    std::string name;
    std::string_view meaning{}; ///< a sentence
    bool isIdentifying = false; ///< part of the entry's identity
    bool isPersonal = false;    ///< identifies a person, a device or a subscription
    std::string_view unit = {};
    std::vector<std::string_view> labels = {}; ///< its texts, if they are known
};

/// One section of a technology's display and its log codes.
struct SectionReference {
    std::string name; ///< CDMA: the path in the template, "1x / Receiver 0"
    std::string path; ///< in the display: "/1x/Receiver 0"
    bool isList = false;
    /// All log codes that the section's record subscribes to, even those that show nothing. The
    /// keys are display keys, for CDMA too.
    std::vector<CodeDescription> codes = {};
    std::string_view meaning = {}; ///< a sentence
    std::vector<ObjectKey> objectKeys = {};
};

struct TechnologyReference {
    const RecordedTechnology* technology; ///< link type and names
    std::string_view title;               ///< "GSM/UMTS"
    std::vector<SectionReference> sections;

    /// The sentence for a key or, with an empty key, for the section; empty if there is none.
    std::string_view meaningOf(std::string_view section, std::string_view key) const;
    /// The name of a log code; empty if there is none.
    std::string_view nameOf(LogCode logCode) const;
};

/// The descriptions of all technologies, by link type, with the sections in the order of the
/// templates in `resources`.
std::vector<TechnologyReference> gatherReference(const Resources& resources);
/// The description of one technology, which needs only its own template.
TechnologyReference gatherReference(const RecordedTechnology& technology,
                                    const Resources& resources);

/// The codes that the technology's sections read, ascending, without duplicates.
std::vector<LogCode> codesOf(const TechnologyReference& technology);

} // namespace pallax
