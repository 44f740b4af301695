#pragma once

#include "LogGenerator/Records/LayoutReader.h"
#include "LogGenerator/Records/ReadTimes.h"
#include "LogGenerator/Records/Sample.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace pallax {

/// The display sink of one section: writes samples into the section that was built from the
/// template. It writes nothing while the section is missing or of the wrong kind.
///
/// Between two ticks a modem sends many records of one kind, and each replaces everything that the
/// one before has shown. This sink keeps the latest and reads it when the display is needed. The
/// layout tells which records may wait.
class SectionDisplay final : public SampleSink {
public:
    static constexpr bool kTakesHidden = false;

    /// `memory` must outlive the sink.
    explicit SectionDisplay(RecordMemory& memory) : _memory(memory) {}

    void setSection(const PropertyList& section);

    /// Whether records may wait until the display is brought up to date; false at first.
    void setLate(bool isLate) { _isLate = isLate; }
    /// Keeps an accepted record that may be read late. The kept one before is dropped if its code
    /// and shape (`shapeOf`, or 0 if the code has no shapes) are the same, else read.
    void keep(const CodeLayout& code, FieldId firstRow, unsigned shape, Time packet,
              const LogRecord& record);
    /// Reads the kept record, if any.
    void bringUpToDate();

    /// Whether `value` is this section.
    bool shows(const PropertyList& value) const;
    /// When the section's values were last read.
    ReadTimes& times() { return _times; }
    const ReadTimes& times() const { return _times; }

    void sample(const Sample& sample) override;
    void keyRemoved(std::string_view key) override;
    void beginList(const SampleList& list) override;
    void endList() override;
    void beginEntry(std::size_t index, std::int64_t name) override;
    void endEntry() override;

private:
    /// A list that has begun but not ended.
    struct Open {
        std::string_view key;
        Array list;
        DictionaryRef entry;  ///< the current one; null before its first key
        bool isPlain = false; ///< the current entry is a value without key
    };

    Dictionary& entryOf(Open& open);
    /// An unshared dictionary of the previous list, or else a new one. (Allocating all entries of
    /// one list took half the time of decoding a UTRAN drive.)
    DictionaryRef spareEntry();

    RecordMemory& _memory;
    DictionaryRef _keys; ///< the section; the one of the other kind is null
    ArrayRef _list;
    std::vector<Open> _open;
    Array _spares;

    ReadTimes _times;

    bool _isLate = false;
    ByteBuffer _kept;
    const CodeLayout* _code = nullptr; ///< of the kept record; null without one
    FieldId _firstRow = 0;
    unsigned _shape = 0;
    Time _packet = {};
};

} // namespace pallax
