#include "tests/docs/ConsoleBlocks.h"

#include <optional>
#include <sstream>

namespace pallax::doubles {

namespace {

constexpr std::string_view kFence = "```";
constexpr std::string_view kPrompt = "$ ";
constexpr std::string_view kCutLines = "...";
constexpr std::string_view kCutText = "…";

/// The line without indentation, which blocks in lists have.
std::string_view unindented(std::string_view line) {
    const std::size_t begin = line.find_first_not_of(' ');
    return begin == std::string_view::npos ? std::string_view() : line.substr(begin);
}

/// Whether the text starts with the first piece, ends with the last and contains the others.
bool isLineShown(std::string_view shown, std::string_view text) {
    const std::size_t cut = shown.find(kCutText);
    if (cut == std::string_view::npos) {
        return shown == text;
    }
    if (!text.starts_with(shown.substr(0, cut))) {
        return false;
    }
    const std::string_view rest = shown.substr(cut + kCutText.size());
    for (std::size_t at = cut; at <= text.size(); ++at) {
        if (isLineShown(rest, text.substr(at))) {
            return true;
        }
    }
    return false;
}

using Lines = std::vector<std::string>;

bool areLinesShown(Lines::const_iterator shown, Lines::const_iterator shownEnd,
                   Lines::const_iterator line, Lines::const_iterator end) {
    for (; shown != shownEnd; ++shown, ++line) {
        if (*shown == kCutLines) {
            for (auto next = line;; ++next) {
                if (areLinesShown(shown + 1, shownEnd, next, end)) {
                    return true;
                }
                if (next == end) {
                    return false;
                }
            }
        }
        if (line == end || !isLineShown(*shown, *line)) {
            return false;
        }
    }
    return line == end;
}

Lines linesOf(std::string_view text) {
    Lines lines;
    std::istringstream stream{std::string(text)};
    for (std::string line; std::getline(stream, line);) {
        lines.push_back(line);
    }
    return lines;
}

/// A document, line by line.
class Reader {
public:
    void take(std::string_view line) {
        ++_line;
        const std::string_view content = unindented(line);
        if (content.starts_with(kFence)) {
            const std::string kind(content.substr(kFence.size()));
            if (!_kind) {
                kinds.push_back(kind);
            }
            _indentation = line.size() - content.size();
            _kind = _kind ? std::nullopt : std::optional(kind);
            _continues = false;
        } else if (_kind == "console") {
            takeShown(line.substr(std::min(_indentation, line.size() - content.size())));
        }
    }

    std::vector<ShownCommand> commands;
    std::vector<std::string> kinds;

private:
    void takeShown(std::string_view line) {
        if (_continues) {
            commands.back().command.append("\n").append(line);
        } else if (line.starts_with(kPrompt)) {
            commands.push_back({std::string(line.substr(kPrompt.size())), {}, _line, kinds.size()});
        } else if (!commands.empty()) {
            commands.back().output.emplace_back(line);
            return;
        }
        _continues = line.ends_with('\\');
    }

    int _line = 0;
    std::optional<std::string> _kind; // of the open block
    std::size_t _indentation = 0;
    bool _continues = false;
};

Reader readThrough(std::string_view document) {
    Reader reader;
    for (const std::string& line : linesOf(document)) {
        reader.take(line);
    }
    return reader;
}

} // namespace

std::vector<ShownCommand> shownCommands(std::string_view document) {
    return readThrough(document).commands;
}

std::vector<std::string> blockKinds(std::string_view document) {
    return readThrough(document).kinds;
}

bool isShown(const std::vector<std::string>& lines, const std::string& text) {
    const Lines printed = linesOf(text);
    return areLinesShown(lines.begin(), lines.end(), printed.begin(), printed.end());
}

} // namespace pallax::doubles
