#pragma once

#include "LogGenerator/Records/LogCode.h"

#include <span>
#include <string_view>

namespace pallax {

/// What a display key tells whose layout does not say it, in one sentence; with an empty key, what
/// its section tells. The keys of a list within a section belong to the section, too.
struct Meaning {
    std::string_view section; ///< for CDMA: the path in the template, "1x / Receiver 0"
    std::string_view key;
    std::string_view sentence;
};

/// The name of a log code.
struct CodeName {
    LogCode logCode;
    std::string_view name;
};

struct Meanings {
    std::span<const Meaning> keys;
    std::span<const CodeName> codes;
};

Meanings cdmaMeanings();
/// For sections and codes of several technologies.
Meanings commonMeanings();
Meanings gsmMeanings();
Meanings ifxMeanings();
Meanings utranMeanings();

} // namespace pallax
