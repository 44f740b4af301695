#pragma once

#include "console/Output.h"
#include "platform/StandardOutput.h"

#include <string>
#include <string_view>

namespace pallax {

/// Keeps the notices that generators print on destruction while the screen uses standard output,
/// and writes them in its destructor.
class KeptNotices final : public StandardOutput {
public:
    explicit KeptNotices(Output::Write write) : _write(std::move(write)) {}
    /// Must run after the terminal is restored. Later notices are lost.
    ~KeptNotices() override;
    KeptNotices(const KeptNotices&) = delete;
    KeptNotices& operator=(const KeptNotices&) = delete;

    void printLine(std::string_view line) override;

private:
    Output::Write _write;
    std::string _lines;
};

} // namespace pallax
