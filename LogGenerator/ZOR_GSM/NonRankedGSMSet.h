#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The GSM cells that are not ranked, section "Non-Ranked GSM Set". No log code is known to carry
/// them: the section shows, and stays empty.
class NonRankedGSMSet final : public Base {
public:
    std::string_view getSectionName() const override { return "Non-Ranked GSM Set"; }
    std::span<const LogCode> getLogCodeArray() const override { return {}; }
    SectionKind sectionKind() const override { return SectionKind::List; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    RecordDescription describe() const override;
};

} // namespace pallax
