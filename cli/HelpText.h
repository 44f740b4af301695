#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// What a command's help says beside its options. It is written as one text, paragraphs with an
/// empty line between them: "Examples:", notes, and last "Exit status:", a status on each line.
struct HelpText {
    struct Status {
        std::string number;
        std::string meaning; ///< without a full stop
    };

    std::string examples; ///< lines, each indented by two blanks
    std::vector<std::string> notes;
    std::vector<Status> statuses;
};

HelpText takenApart(std::string_view text);

} // namespace pallax
