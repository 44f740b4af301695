#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The mobility-management state as the connection-oriented side sees it, section "Process CO".
///
///   0x7132, at least 16 bytes
///   byte  width  key                 shown as
///   13    8      MM Service State    label (kRegistrationStates), "Unknown" beyond
///
///   0x7131, at least 16 bytes
///   byte  width  key                 shown as
///   13    8      MM State            label (kMMStates), "Unknown" beyond
class ProcessCO final : public Base {
public:
    std::string_view getSectionName() const override { return "Process CO"; }
    std::span<const LogCode> getLogCodeArray() const override;
    void updateWithData(const LogRecord& record, LogCode logCode) override;
};

} // namespace pallax
