#pragma once

#include "platform/StandardOutput.h"

namespace pallax {

/// Discards the notices that generators print on destruction, because standard output carries only
/// displays.
class DroppedNotices final : public StandardOutput {
public:
    void printLine(std::string_view /*line*/) override {}
};

} // namespace pallax
