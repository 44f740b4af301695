#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::doubles {

/// A command of a document, and what the document says that it prints.
struct ShownCommand {
    std::string command;
    std::vector<std::string> output; ///< lines; none where the document does not show any
    int line = 0;                    ///< of the document, from 1 on
    std::size_t block = 0;           ///< number of its block, from 1 on
};

/// The commands of a document's fenced `console` blocks: lines that begin with "$ ", and after one
/// that ends with a backslash the next. Lines that follow are what the command prints.
std::vector<ShownCommand> shownCommands(std::string_view document);

/// The kinds of all fenced blocks ("console"), in their order; empty texts for those without.
std::vector<std::string> blockKinds(std::string_view document);

/// Whether the text is what the lines show: a line "..." stands for any number of lines, "…" for
/// any text within a line.
bool isShown(const std::vector<std::string>& lines, const std::string& text);

} // namespace pallax::doubles
