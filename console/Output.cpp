#include "console/Output.h"

#include "host/Interruption.h"
#include "text/Format.h"
#include "text/Printable.h"

#include <cerrno>
#include <system_error>
#include <unistd.h>

namespace pallax {

namespace {

void writeWhole(int descriptor, const std::string& name, std::string_view block) {
    while (!block.empty()) {
        const ssize_t written = ::write(descriptor, block.data(), block.size());
        if (written >= 0) {
            block.remove_prefix(static_cast<std::size_t>(written));
        } else if (errno == EPIPE || (errno == EINTR && Interruption::isDue())) {
            throw OutputClosed();
        } else if (errno != EINTR) {
            const std::string reason = std::generic_category().message(errno);
            throw OutputFailure(formatText("%@ cannot be written: %@.", {name, reason}));
        }
    }
}

} // namespace

void Output::lineDone() {
    if (_text.size() >= kBlockSize) {
        flush();
    }
}

void Output::flush() {
    if (!_text.empty()) {
        _taken.clear();
        std::swap(_text, _taken); // a failed write is not repeated
        _write(_taken);
    }
}

Output::Write writeToDescriptor(int descriptor, std::string name) {
    if (::isatty(descriptor) == 0) {
        return [descriptor, name = std::move(name)](std::string_view block) {
            writeWhole(descriptor, name, block);
        };
    }
    return [descriptor, name = std::move(name),
            pieces = PrintablePieces()](std::string_view block) mutable {
        std::string text;
        pieces.append(text, block);
        writeWhole(descriptor, name, text);
    };
}

} // namespace pallax
