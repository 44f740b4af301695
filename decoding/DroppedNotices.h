#pragma once

#include "platform/StandardOutput.h"

namespace pallax {

/// Drops the notices that generators print when they end: while displays are written to standard
/// output, nothing else may be.
class DroppedNotices final : public StandardOutput {
public:
    void printLine(std::string_view /*line*/) override {}
};

} // namespace pallax
