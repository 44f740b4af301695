#include "host/Complaint.h"

#include "text/Printable.h"

#include <cstdio>
#include <string>

namespace pallax {

namespace {

/// Errors are ignored: the exit status reports the failure too.
void writeToStandardError(const std::string& text) {
    (void)std::fwrite(text.data(), 1, text.size(), stderr);
}

} // namespace

void complain(std::string_view sentence) {
    std::string line = "pallax: ";
    appendPrintable(line, sentence);
    line += '\n';
    writeToStandardError(line);
}

void passOnComplaints(std::string_view lines) {
    std::string text;
    appendPrintableLines(text, lines);
    writeToStandardError(text);
}

} // namespace pallax
