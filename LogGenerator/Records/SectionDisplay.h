#pragma once

#include "LogGenerator/Records/LayoutReader.h"
#include "LogGenerator/Records/ReadTimes.h"
#include "LogGenerator/Records/Sample.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace pallax {

/// The display sink of one section: writes samples into the section that the template processing
/// has built. It writes nothing while there is no section, or one of the wrong kind.
///
/// Between two looks at the display a modem sends many records of one kind, each of which replaces
/// all that the one before has shown. Such a record is kept, and read when the display is looked
/// at; the layout tells which may be.
class SectionDisplay final : public SampleSink {
public:
    static constexpr bool kTakesHidden = false;

    /// `memory` outlives it.
    explicit SectionDisplay(RecordMemory& memory) : _memory(memory) {}

    void setSection(const PropertyList& section);

    /// Whether records may wait until the display is brought up to date; not, unless it is set.
    void setLate(bool isLate) { _isLate = isLate; }
    /// How a record is read. Null code: none.
    struct Reading {
        const CodeLayout* code = nullptr;
        FieldId firstRow = 0;
        unsigned shape = 0; ///< its `shapeOf`, or 0 where the code has no shapes
        Time packet = {};
    };
    /// Keeps an accepted record that may be read late, in place of the one before.
    void keep(const Reading& reading, const LogRecord& record);
    /// Reads the record that is kept.
    void bringUpToDate();

    /// Whether it is the section.
    bool shows(const PropertyList& value) const;
    /// Of what the section shows.
    ReadTimes& times() { return _times; }
    const ReadTimes& times() const { return _times; }

    void sample(const Sample& sample) override;
    void keyRemoved(std::string_view key) override;
    void beginList(const SampleList& list) override;
    void endList() override;
    void beginEntry(std::size_t index, std::int64_t name) override;
    void endEntry() override;

private:
    /// A list that has begun and not ended.
    struct Open {
        std::string_view key;
        Array list;
        DictionaryRef entry;  ///< that is being filled; null before its first key
        bool isPlain = false; ///< its entry was a value without key
    };

    Dictionary& entryOf(Open& open);
    /// A dictionary of the list that was there before, where nobody else holds it, else a new one.
    /// Made anew, the entries of one list took half of the time of decoding a UTRAN drive.
    DictionaryRef spareEntry();

    RecordMemory& _memory;
    DictionaryRef _keys; ///< the section, of one or the other kind
    ArrayRef _list;
    std::vector<Open> _open;
    Array _spares;

    ReadTimes _times;

    bool _isLate = false;
    Reading _reading; ///< of the record that is kept
    ByteBuffer _kept;
};

} // namespace pallax
