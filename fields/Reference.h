#pragma once

#include "fields/Description.h"
#include "fields/Meanings.h"
#include "platform/Resources.h"

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

struct RecordedTechnology;

/// One section of a technology's display and its log codes.
struct SectionReference {
    std::string name; ///< of CDMA: the path in the template, "1x / Receiver 0"
    std::string path; ///< of the section in the display: "/1x/Receiver 0"
    bool isList = false;
    /// Every log code that the section's record subscribes to, even if it shows nothing. The keys
    /// are display keys, for CDMA too.
    std::vector<CodeDescription> codes = {};
    /// IFX: the keys, which have no log code.
    std::vector<std::string> objectKeys = {};
    std::vector<std::string> identifyingKeys = {}; ///< of those: which cell an entry is
    /// Of the section: a sentence, where its layout holds one.
    std::string_view meaning = {};
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

/// The descriptions of all technologies, by link type; the sections are in the order of the
/// templates in `resources`.
std::vector<TechnologyReference> gatherReference(const Resources& resources);
/// The same of one technology, which needs only its own template.
TechnologyReference gatherReference(const RecordedTechnology& technology,
                                    const Resources& resources);

/// The sentences of a technology that stand in no layout, without those that several have in
/// common.
Meanings meaningsOf(const TechnologyReference& technology);

/// The codes of a technology that a section reads, ascending, each once.
std::vector<LogCode> codesOf(const TechnologyReference& technology);

} // namespace pallax
