#pragma once

#include "console/Output.h"
#include "platform/StandardOutput.h"

#include <string>
#include <string_view>

namespace pallax {

/// Keeps the notices that generators print when they end, for standard output is the screen that is
/// being drawn, and writes them at its own end.
class KeptNotices final : public StandardOutput {
public:
    explicit KeptNotices(Output::Write write) : _write(std::move(write)) {}
    /// To come when the terminal is restored. One that has gone misses the notices.
    ~KeptNotices() override;
    KeptNotices(const KeptNotices&) = delete;
    KeptNotices& operator=(const KeptNotices&) = delete;

    void printLine(std::string_view line) override;

private:
    Output::Write _write;
    std::string _lines;
};

} // namespace pallax
