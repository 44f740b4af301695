#pragma once

#include "LogGenerator/Records/Base.h"

namespace pallax {

/// The block error rates of the transport channels, section "TRCH BLER".
///
///   0xD00C, see ChannelQuality.h
///
///   transport channel
///   byte  width  key                    shown as
///   0     8      TRCH ID                number
///   1     8      TRCH BLER Measurement  number
///
/// Short records and other codes are ignored silently.
class TRCHBLERMeasurement final : public Base {
public:
    std::string_view getSectionName() const override { return "TRCH BLER"; }
    std::span<const LogCode> getLogCodeArray() const override;
    SectionKind sectionKind() const override { return SectionKind::List; }
    void updateWithData(const LogRecord& record, LogCode logCode) override;
    bool replacesShown(const LogRecord& record, LogCode logCode) const override;
    RecordDescription describe() const override;
};

} // namespace pallax
