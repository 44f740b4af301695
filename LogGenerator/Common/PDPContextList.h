#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The packet-data contexts as the telephony service describes them, section "PDP Context Info".
///
///   0xFF0002: a property list from byte 13 on, an array; the list becomes its elements, unchanged
///
/// A payload that is no array, or no property list at all, changes nothing and is not reported.
class PDPContextList final : public Base {
public:
    std::string_view getSectionName() const override { return "PDP Context Info"; }
    std::span<const LogCode> getLogCodeArray() const override;
    SectionKind sectionKind() const override { return SectionKind::List; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    RecordDescription describe() const override;
};

} // namespace pallax
