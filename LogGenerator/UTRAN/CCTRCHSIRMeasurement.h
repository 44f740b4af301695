#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The signal-to-interference ratios of the coded composite transport channels, section
/// "CCTRCH SIR".
///
///   0xD00C, see ChannelQuality.h
///
///   composite channel
///   byte  width   key        shown as
///   0     8       CCTRCH ID  number
///   1     8       TSNUM      number
///   2     6 byte  SIR        list of six numbers, one a byte
///
/// Short records and other codes are ignored silently.
class CCTRCHSIRMeasurement final : public Base {
public:
    std::string_view getSectionName() const override { return "CCTRCH SIR"; }
    std::span<const LogCode> getLogCodeArray() const override;
    SectionKind sectionKind() const override { return SectionKind::List; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    bool replacesShown(const LogRecord& record, LogCode logCode) const override;
    RecordDescription describe() const override;
};

} // namespace pallax
