#pragma once

#include "platform/StandardOutput.h"

#include <string>
#include <vector>

namespace pallax::doubles {

/// Keeps the printed lines.
class FakeStandardOutput final : public StandardOutput {
public:
    void printLine(std::string_view line) override { lines.emplace_back(line); }

    std::vector<std::string> lines;
};

} // namespace pallax::doubles
