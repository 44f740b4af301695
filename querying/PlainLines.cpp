#include "querying/Interrupt.h"
#include "querying/LineReader.h"

#include <cerrno>

namespace pallax {

LineReader::Outcome PlainLines::read(const std::string& before, std::string& line) {
    const Interrupt interrupt(_hasPrompt ? Interrupt::Watched::Yes : Interrupt::Watched::No);
    if (_hasPrompt) {
        (void)std::fputs(before.empty() ? kPrompt : kPromptOfMore, stderr);
    }
    line.clear();
    while (line.size() <= kLongestStatement) {
        const int character = std::getc(&_file);
        if (character == EOF && std::ferror(&_file) != 0 && errno == EINTR && interrupt.hasCome()) {
            std::clearerr(&_file);
            (void)std::fputc('\n', stderr);
            return Outcome::Cleared;
        }
        if (character == EOF) {
            return line.empty() ? Outcome::End : Outcome::Line;
        }
        if (character == '\n') {
            return Outcome::Line;
        }
        line += static_cast<char>(character);
    }
    return Outcome::Line;
}

} // namespace pallax
