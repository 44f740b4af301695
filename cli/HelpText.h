#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The parts of a command's help besides its options. They are written as one text, paragraphs
/// separated by an empty line: "Examples:", notes, and last "Exit status:", one status per line.
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
