#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The cell-change counters, section "Cell Change Counters". No log code is known to carry them:
/// the section shows, and stays empty.
class CellChangeCounters final : public Base {
public:
    std::string_view getSectionName() const override { return "Cell Change Counters"; }
    std::span<const LogCode> getLogCodeArray() const override { return {}; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    RecordDescription describe() const override;
};

} // namespace pallax
