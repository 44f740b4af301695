#pragma once

#include <string_view>

namespace pallax {

/// The process's standard output, on which a few destruction notices are printed.
class StandardOutput {
public:
    virtual ~StandardOutput() = default;
    virtual void printLine(std::string_view line) = 0;
};

} // namespace pallax
