#pragma once

#include <string_view>

namespace pallax {

/// The process's standard output, for a few destruction notices.
class StandardOutput {
public:
    virtual ~StandardOutput() = default;
    virtual void printLine(std::string_view line) = 0;
};

} // namespace pallax
