#include "query/QueryErrorText.h"

#include "text/Format.h"
#include "text/Suggestion.h"

#include <algorithm>

namespace pallax {

namespace {

/// A suggestion of a name that has the word in it, best at its end: "measured_rsrp" for "rsrp",
/// "rrc_state" for "rrc".
std::string longerName(const std::string& word, const std::vector<std::string>& names) {
    auto found = std::find_if(names.begin(), names.end(),
                              [&](const std::string& name) { return name.ends_with("_" + word); });
    if (found == names.end()) {
        found = std::find_if(names.begin(), names.end(), [&](const std::string& name) {
            return ("_" + name + "_").find("_" + word + "_") != std::string::npos;
        });
    }
    return found != names.end() ? formatText(". Did you mean \"%@\"?", {*found}) : std::string();
}

} // namespace

std::string queryErrorText(const QueryError& error, std::string_view text,
                           const std::vector<std::string>& names, std::string_view subject) {
    std::string sentence = error.sentence;
    const std::size_t colon = sentence.rfind(": ");
    if (colon != std::string::npos && sentence.starts_with("no such")) {
        const std::string name = sentence.substr(colon + 2);
        const std::string word = name.substr(name.rfind('.') + 1);
        const std::string near = suggestion(word, names);
        sentence += near.empty() ? longerName(word, names) : near;
    }
    if (error.place && *error.place <= text.size()) {
        const std::string_view before = text.substr(0, *error.place);
        const auto line = std::count(before.begin(), before.end(), '\n') + 1;
        const std::size_t column = before.size() - (before.rfind('\n') + 1) + 1;
        sentence += formatText(" (line %lld, column %zu of the %@)", {line, column, subject});
    }
    return sentence;
}

} // namespace pallax
