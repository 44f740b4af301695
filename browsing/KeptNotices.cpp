#include "browsing/KeptNotices.h"

#include <exception>

namespace pallax {

KeptNotices::~KeptNotices() {
    if (_lines.empty()) {
        return;
    }
    try {
        _write(_lines);
    } catch (const std::exception&) { // the terminal has gone
    }
}

void KeptNotices::printLine(std::string_view line) {
    _lines += line;
    _lines += '\n';
}

} // namespace pallax
