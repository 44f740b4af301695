#pragma once

#include "decoding/DisplayOutput.h"
#include "decoding/FieldSelection.h"
#include "timeline/CurrentValues.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

/// The output of `decode --samples`: a line for each value that was read from a packet, with time,
/// packet, field, the place of its list entry (from 1) and what identifies it, the number in the
/// record, the value (its number if it has one) and its unit. Of a packet that cannot be read
/// nothing is written.
class SampleOutput final : public DisplayOutput,
                           public SampleSink,
                           private CurrentValues::Listener {
public:
    /// The head of CSV: "time,packet,field,index,entry,raw,value,unit".
    static void appendHead(std::string& out, bool withRecording);

    struct Form {
        DecodeFormat format = DecodeFormat::Json;
        std::vector<std::string> select = {}; ///< names of fields; if empty, all
        /// CSV: the first cell of each line, or empty.
        std::string recording = {};
    };

    SampleOutput(Output& output, Form form, FieldTable fields);

    void beginRecording() override {}
    void show(const DisplayMoment& /*moment*/, const PropertyList& /*display*/) override {}
    void packetDone(const DisplayMoment& moment) override;

    void beginPacket(const SamplePacket& packet) override;
    void beginSection(std::string_view section) override { _values.beginSection(section); }
    void sample(const Sample& sample) override { _values.sample(sample); }
    void keyRemoved(std::string_view key) override { _values.keyRemoved(key); }
    void beginList(const SampleList& list) override { _values.beginList(list); }
    void endList() override { _values.endList(); }
    void beginEntry(std::size_t index, std::int64_t name) override;
    void endEntry() override;

private:
    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override;
    void valueRemoved(FieldIndex /*field*/) override {}
    void listReplaced(ListId /*list*/) override {}

    void writeJson(const FieldInfo& field, EntryId entry, const FieldValue& value);
    void writeCsv(const FieldInfo& field, EntryId entry, const FieldValue& value);

    Output& _output;
    Form _form;
    FieldTable _fields;
    EntryTable _entries;
    CurrentValues _values;
    ChosenFields _chosen;
    std::string _start;               ///< of each line of the packet
    std::string _lines;               ///< of the packet
    std::vector<std::size_t> _places; ///< of the open entries in their lists, from 1
};

/// The number of a value, whole where the display's is; null if it has none.
PropertyList numberOf(const FieldValue& value);
/// The value without its unit: its number or, if it has none, its text.
std::string bareText(const FieldValue& value);
/// The unit that a number is shown with; empty for other values.
std::string_view unitOf(const FieldValue& value, const FieldInfo& field);

} // namespace pallax
