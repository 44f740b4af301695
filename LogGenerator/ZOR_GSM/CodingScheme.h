#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The GPRS coding schemes, section "Coding Scheme". No log code is known to carry them: the
/// section shows, and stays empty.
class CodingScheme final : public Base {
public:
    std::string_view getSectionName() const override { return "Coding Scheme"; }
    std::span<const LogCode> getLogCodeArray() const override { return {}; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    RecordDescription describe() const override;
};

} // namespace pallax
