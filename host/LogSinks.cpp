#include "host/LogSinks.h"

#include "text/Printable.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <syslog.h>
#include <unistd.h>

namespace pallax {

namespace {

/// Failures are kept in the stream's state.
void writeTo(std::FILE* file, std::string_view lines) {
    (void)std::fwrite(lines.data(), 1, lines.size(), file);
}

bool isTerminal(std::FILE* file) {
    return ::isatty(::fileno(file)) != 0;
}

} // namespace

std::string logLine(LogPriority priority, std::string_view text) {
    std::string line = formatText("<%d>%@", {static_cast<int>(priority), text});
    if (!text.ends_with('\n')) {
        line += '\n';
    }
    return line;
}

SyslogSink::SyslogSink(std::string identity) : _identity(std::move(identity)) {
    ::openlog(_identity.c_str(), LOG_PID, LOG_USER);
}

SyslogSink::~SyslogSink() {
    ::closelog();
}

void SyslogSink::write(LogPriority priority, std::string_view text) {
    const int length = static_cast<int>(text.size());
    ::syslog(static_cast<int>(priority), "%.*s", length, text.data()); // NOLINT: syslog's way
}

StderrSink::StderrSink() : _isTerminal(isTerminal(stderr)) {}

void StderrSink::write(LogPriority priority, std::string_view text) {
    const std::string line = logLine(priority, text);
    std::string harmless;
    if (_isTerminal) {
        appendPrintableLines(harmless, line);
    }
    writeTo(stderr, _isTerminal ? harmless : line);
}

Result<std::unique_ptr<FileSink>, HostError> FileSink::create(const std::string& path) {
    std::FILE* file = std::fopen(path.c_str(), "we");
    if (file == nullptr) {
        return HostError{
            formatText("The log file %@ cannot be written: %@.", {path, std::strerror(errno)})};
    }
    return std::unique_ptr<FileSink>(new FileSink(file));
}

Result<std::unique_ptr<FileSink>, HostError> FileSink::onto(int descriptor) {
    const int duplicate = ::fcntl(descriptor, F_DUPFD_CLOEXEC, 0);
    std::FILE* file = duplicate >= 0 ? ::fdopen(duplicate, "w") : nullptr;
    if (file == nullptr) {
        const int reason = errno;
        if (duplicate >= 0) {
            (void)::close(duplicate);
        }
        return HostError{formatText("The log cannot be written: %@.", {std::strerror(reason)})};
    }
    return std::unique_ptr<FileSink>(new FileSink(file));
}

FileSink::FileSink(std::FILE* file) : _file(file), _isTerminal(isTerminal(file)) {}

FileSink::~FileSink() {
    (void)std::fclose(_file);
}

void FileSink::write(LogPriority priority, std::string_view text) {
    append(logLine(priority, text));
}

void FileSink::append(std::string_view lines) {
    std::string harmless;
    if (_isTerminal) {
        _pieces.append(harmless, lines);
    }
    writeTo(_file, _isTerminal ? harmless : lines);
}

bool FileSink::flush() {
    return std::fflush(_file) == 0 && std::ferror(_file) == 0;
}

} // namespace pallax
