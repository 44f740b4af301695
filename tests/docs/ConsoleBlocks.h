#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax::doubles {

/// A command in a document, and the output that the document shows.
struct ShownCommand {
    std::string command;
    std::vector<std::string> output; ///< lines; empty if the document shows none
    int line = 0;                    ///< line in the document, from 1
    std::size_t block = 0;           ///< number of its block, from 1
};

/// The commands in a document's fenced `console` blocks: lines that begin with "$ ", and the next
/// line after each that ends with a backslash. The lines that follow are the command's output.
std::vector<ShownCommand> shownCommands(std::string_view document);

/// The kinds of all fenced blocks ("console"), in order; an empty text for a block without a kind.
std::vector<std::string> blockKinds(std::string_view document);

/// Whether the lines match the text: a line "..." matches any number of lines, "…" any text in a
/// line.
bool isShown(const std::vector<std::string>& lines, const std::string& text);

} // namespace pallax::doubles
