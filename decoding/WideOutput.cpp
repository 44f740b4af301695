#include "decoding/WideOutput.h"

#include "decoding/SampleOutput.h"
#include "text/Csv.h"

#include <algorithm>

namespace pallax {

WideOutput::WideOutput(Output& output, Form form, FieldTable fields)
    : _output(output), _form(std::move(form)), _fields(std::move(fields)),
      _values(_fields, _entries), _chosen(_form.select, _fields) {
    _values.setListener(this);
    if (!_form.recording.empty()) {
        appendCsvCell(_start, _form.recording);
        _start += ',';
    }
}

void WideOutput::valueRead(FieldIndex field, EntryId entry, const FieldValue& /*value*/) {
    if (_chosen.has(field) && !hasTooManyColumns() &&
        _places.emplace(Column{field, entry}, _columns.size()).second) {
        _columns.emplace_back(field, entry);
    }
}

void WideOutput::beginRows() {
    // The fields stand in the order of the display, the entries as they came.
    std::sort(_columns.begin(), _columns.end());
    for (std::size_t place = 0; place < _columns.size(); ++place) {
        _places[_columns[place]] = place;
    }
    _values.setListener(nullptr);
    _values.clear();
    _areRowsWritten = true;
    std::string& head = _output.text();
    head += _form.recording.empty() ? "time," : "recording,time,";
    head += _form.every == Every::Tick ? "tick" : "packet";
    for (const auto& [field, entry] : _columns) {
        std::string name = _fields[field].name;
        if (entry != kNoEntry) {
            name.append("[").append(_entries.words(entry)).append("]");
        }
        head += ',';
        appendCsvCell(head, name);
    }
    head += '\n';
    _output.lineDone();
}

void WideOutput::show(const DisplayMoment& moment, const PropertyList& /*display*/) {
    if (_form.every != Every::Packet) {
        writeRow(moment);
    }
}

void WideOutput::packetDone(const DisplayMoment& moment) {
    if (_form.every == Every::Packet) {
        writeRow(moment);
    }
}

void WideOutput::writeRow(const DisplayMoment& moment) {
    if (!_areRowsWritten) {
        return;
    }
    _row.assign(_columns.size(), nullptr);
    for (std::size_t place = 0; place < _columns.size(); ++place) {
        const auto& [field, entry] = _columns[place];
        _row[place] = entry == kNoEntry ? _values.value(field) : nullptr;
    }
    _values.forEachEntry([this](const EntryValues& entry) {
        for (const auto& [field, value] : entry.values) {
            const auto place = _places.find({field, entry.entry});
            if (place != _places.end()) {
                _row[place->second] = &value;
            }
        }
    });
    std::string& text = _output.text();
    text.append(_start).append(isoTimeText(moment.time)).append(",");
    text += std::to_string(moment.number);
    for (const FieldValue* value : _row) {
        text += ',';
        appendCsvCell(text, value != nullptr ? bareText(*value) : std::string());
    }
    text += '\n';
    _output.lineDone();
}

} // namespace pallax
