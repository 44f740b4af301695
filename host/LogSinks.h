#pragma once

#include "host/HostError.h"
#include "platform/SystemLog.h"
#include "text/Printable.h"
#include "text/Result.h"

#include <cstdio>
#include <memory>
#include <string>
#include <string_view>

/// Where the system log goes on Linux. A priority is passed on as the number it is; one beyond
/// the levels (16) names, to syslog, a facility with the level 0.
namespace pallax {

/// "<4>text" and a newline; a text that ends in one gets no second.
std::string logLine(LogPriority priority, std::string_view text);

class SyslogSink final : public LogSink {
public:
    /// `identity` stands before every line of the log.
    explicit SyslogSink(std::string identity);
    ~SyslogSink() override;
    SyslogSink(const SyslogSink&) = delete;
    SyslogSink& operator=(const SyslogSink&) = delete;
    void write(LogPriority priority, std::string_view text) override;

private:
    std::string _identity; // syslog keeps a pointer to it
};

/// Lines on standard error. Where that is a terminal, what a modem's text could tell it to do is
/// replaced; a file gets every byte.
class StderrSink final : public LogSink {
public:
    StderrSink();
    explicit StderrSink(bool isTerminal) : _isTerminal(isTerminal) {}
    void write(LogPriority priority, std::string_view text) override;

private:
    bool _isTerminal;
};

/// Lines in a file, which is emptied first; a terminal in its place gets what commands it as
/// escapes. They are written through when the sink is destroyed and whenever the buffer is full.
class FileSink final : public LogSink {
public:
    static Result<std::unique_ptr<FileSink>, HostError> create(const std::string& path);
    /// On a descriptor, of which it uses a duplicate.
    static Result<std::unique_ptr<FileSink>, HostError> onto(int descriptor);
    ~FileSink() override;
    FileSink(const FileSink&) = delete;
    FileSink& operator=(const FileSink&) = delete;
    void write(LogPriority priority, std::string_view text) override;
    /// Lines as another sink has written them.
    void append(std::string_view lines);
    /// Writes what is buffered; false when any line could not be written.
    bool flush();

private:
    explicit FileSink(std::FILE* file);
    std::FILE* _file;
    bool _isTerminal;
    PrintablePieces _pieces; ///< of what goes to a terminal
};

} // namespace pallax
