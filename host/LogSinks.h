#pragma once

#include "host/HostError.h"
#include "platform/SystemLog.h"
#include "text/Printable.h"
#include "text/Result.h"

#include <cstdio>
#include <memory>
#include <string>
#include <string_view>

/// The sinks of the system log on Linux. A priority is passed on unchanged; for syslog, one beyond
/// the levels (16) is a facility with level 0.
namespace pallax {

/// "<4>text" and a newline, unless the text already ends in one.
std::string logLine(LogPriority priority, std::string_view text);

class SyslogSink final : public LogSink {
public:
    /// `identity` precedes every line of the log.
    explicit SyslogSink(std::string identity);
    ~SyslogSink() override;
    SyslogSink(const SyslogSink&) = delete;
    SyslogSink& operator=(const SyslogSink&) = delete;
    void write(LogPriority priority, std::string_view text) override;

private:
    std::string _identity; // syslog keeps a pointer to it
};

/// Lines on standard error. On a terminal, characters that could command it are escaped; a file
/// gets every byte.
class StderrSink final : public LogSink {
public:
    StderrSink();
    explicit StderrSink(bool isTerminal) : _isTerminal(isTerminal) {}
    void write(LogPriority priority, std::string_view text) override;

private:
    bool _isTerminal;
};

/// Lines in a file, which is truncated first; if it is a terminal, characters that could command it
/// are escaped. The buffer is written when it is full and on destruction.
class FileSink final : public LogSink {
public:
    static Result<std::unique_ptr<FileSink>, HostError> create(const std::string& path);
    /// Writes to a duplicate of the descriptor.
    static Result<std::unique_ptr<FileSink>, HostError> onto(int descriptor);
    ~FileSink() override;
    FileSink(const FileSink&) = delete;
    FileSink& operator=(const FileSink&) = delete;
    void write(LogPriority priority, std::string_view text) override;
    /// Appends lines that another sink has formatted.
    void append(std::string_view lines);
    /// Writes the buffer; false if any line could not be written.
    bool flush();

private:
    explicit FileSink(std::FILE* file);
    std::FILE* _file;
    bool _isTerminal;
    PrintablePieces _pieces; ///< of the output to a terminal
};

} // namespace pallax
