#pragma once

#include "LogGenerator/Records/Base.h"
#include "LogGenerator/Records/Layout.h"
#include "LogGenerator/Records/SectionDisplay.h"

#include <optional>
#include <string_view>
#include <vector>

namespace pallax {

/// A record class whose layout is its decoder.
class LayoutRecord : public Base {
public:
    /// `layout` must live as long as the program.
    explicit LayoutRecord(const RecordLayout& layout);

    const RecordLayout& layout() const { return _layout; }
    std::string_view getSectionName() const override { return _layout.section; }
    std::span<const LogCode> getLogCodeArray() const override { return _logCodes; }
    void updateSectionRef(PropertyList section) override;
    /// Logs the record and gives its samples to the sink at once; the display may read it later.
    void updateWithData(const LogRecord& record, LogCode logCode) override;

    /// The kind of section that the template must hold for this record.
    SectionKind sectionKind() const { return _layout.kind; }
    /// The display sink of the section.
    SectionDisplay& display() { return _display; }

    /// What the record keeps beside its section.
    RecordMemory& memory() { return _memory; }

    /// `first` is the number of this record's first row. `packet` has the time of each packet when
    /// it arrives and must outlive the record. Before the first call rows count from 0 and have no
    /// time.
    void setPlace(FieldId first, const Time& packet);
    /// Also gives the samples of later records to `sink`; null stops it. The sink must outlive the
    /// record or be removed first.
    void setSink(SampleSink* sink) { _sink = sink; }

    /// When the section, and each of its own keys, was last read.
    std::optional<Time> lastRead() const { return _display.times().latest(); }
    std::optional<Time> lastRead(std::string_view key) const;

private:
    /// Facts about a code's layout, computed once; most packets need no others.
    struct Code {
        LogCode logCode;
        const CodeLayout* layout;
        FieldId firstRow; ///< relative to the record's first
        std::size_t minimumLength;
        bool isPlain; ///< long enough records are accepted, and log nothing further
        bool isReadLate;
        bool hasShapes;
    };

    const Code* codeOf(LogCode logCode) const;
    Time packetTime() const { return _packet != nullptr ? *_packet : Time(); }
    static bool accepts(const CodeLayout& layout, const LogRecord& record);
    void readNow(const Code& code, const LogRecord& record);

    const RecordLayout& _layout;
    std::vector<Code> _codes;
    std::vector<LogCode> _logCodes;
    RecordMemory _memory;
    SectionDisplay _display;
    SampleSink* _sink = nullptr;
    FieldId _firstRow = 0;
    const Time* _packet = nullptr;
};

} // namespace pallax
