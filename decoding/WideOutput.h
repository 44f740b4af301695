#pragma once

#include "decoding/DisplayOutput.h"
#include "decoding/FieldSelection.h"
#include "timeline/CurrentValues.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

namespace pallax {

/// The output of `decode --wide`: CSV with a column for each field, and for each list entry that
/// the field had a value in, by its identity. A recording is decoded twice: first for its columns,
/// then for its rows. A row has the values that are current at its tick or packet; cells are empty
/// where there is none.
class WideOutput final : public DisplayOutput, private CurrentValues::Listener {
public:
    /// Spreadsheets have no more columns.
    static constexpr std::size_t kMostColumns = 16384;

    struct Form {
        std::vector<std::string> select = {}; ///< names of fields; if empty, all
        Every every = Every::Tick;
        std::string recording = {}; ///< the first cell of each row, or empty
    };

    WideOutput(Output& output, Form form, FieldTable fields);

    /// The sink of both passes.
    SampleSink& samples() { return _values; }
    bool hasTooManyColumns() const { return _columns.size() > kMostColumns; }
    /// Ends the first pass: writes the head.
    void beginRows();

    void beginRecording() override {}
    void show(const DisplayMoment& moment, const PropertyList& display) override;
    void packetDone(const DisplayMoment& moment) override;

private:
    using Column = std::pair<FieldIndex, EntryId>;
    struct Hash {
        std::size_t operator()(const Column& column) const {
            constexpr unsigned kHalf = 32;
            return std::hash<std::uint64_t>()(std::uint64_t{column.first} << kHalf | column.second);
        }
    };

    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override;
    void valueRemoved(FieldIndex /*field*/) override {}
    void listReplaced(ListId /*list*/) override {}
    void writeRow(const DisplayMoment& moment);

    Output& _output;
    Form _form;
    FieldTable _fields;
    EntryTable _entries;
    CurrentValues _values;
    ChosenFields _chosen;
    bool _areRowsWritten = false;
    std::vector<Column> _columns;
    std::unordered_map<Column, std::size_t, Hash> _places; ///< of the columns
    std::vector<const FieldValue*> _row;
    std::string _start; ///< of each row
};

} // namespace pallax
