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
    /// `layout` lives as long as the program.
    explicit LayoutRecord(const RecordLayout& layout);

    const RecordLayout& layout() const { return _layout; }
    std::string_view getSectionName() const override { return _layout.section; }
    std::span<const LogCode> getLogCodeArray() const override { return _logCodes; }
    void updateSectionRef(PropertyList section) override;
    /// Logs what the record tells, and gives its samples to the sink at once; the display may take
    /// them later.
    void updateWithData(const LogRecord& record, LogCode logCode) override;

    /// What kind of section the template must hold for this record.
    SectionKind sectionKind() const { return _layout.kind; }
    /// Shows the section.
    SectionDisplay& display() { return _display; }

    /// This record's rows are numbered from `first` on, and `packet` is the time of each packet
    /// when it arrives; it outlives the record. Without them: from 0 on, and no time.
    void setPlace(FieldId first, const Time& packet);
    /// Gives the samples of later records to `sink`, too. Null: to the display alone. The sink
    /// outlives the record, or is taken away.
    void setSink(SampleSink* sink) { _sink = sink; }

    /// When the section was last read, and what it shows under a key of its own.
    std::optional<Time> lastRead() const { return _display.times().latest(); }
    std::optional<Time> lastRead(std::string_view key) const;

private:
    /// What is worked out once of a code's layout: most packets need no more.
    struct Code {
        LogCode logCode;
        const CodeLayout* layout;
        FieldId firstRow; ///< from the record's first
        std::size_t minimumLength;
        bool isPlain; ///< a long enough record is accepted, and logs nothing of its own
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
