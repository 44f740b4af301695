#include "decoding/SampleOutput.h"

#include "decoding/DisplayJson.h"
#include "text/Csv.h"

#include <cmath>
#include <utility>

namespace pallax {

SampleOutput::SampleOutput(Output& output, Form form, FieldTable fields)
    : _output(output), _form(std::move(form)), _fields(std::move(fields)),
      _values(_fields, _entries), _chosen(_form.select, _fields) {
    _values.setListener(this);
}

void SampleOutput::appendHead(std::string& out, bool withRecording) {
    out.append(withRecording ? "recording," : "")
        .append("time,packet,field,index,entry,raw,value,unit\n");
}

void SampleOutput::packetDone(const DisplayMoment& /*moment*/) {
    _output.text() += _lines;
    _output.lineDone();
}

void SampleOutput::beginPacket(const SamplePacket& packet) {
    _values.beginPacket(packet);
    _places.clear();
    _lines.clear();
    const std::string time = isoTimeText(packet.time);
    const std::string number = std::to_string(packet.number);
    if (_form.format == DecodeFormat::Json) {
        _start = R"({"time":")" + time + R"(","packet":)" + number + R"(,"field":)";
    } else {
        _start.clear();
        if (!_form.recording.empty()) {
            appendCsvCell(_start, _form.recording);
            _start += ',';
        }
        _start.append(time).append(",").append(number).append(",");
    }
}

void SampleOutput::beginEntry(std::size_t index, std::int64_t name) {
    _places.push_back(index + 1);
    _values.beginEntry(index, name);
}

void SampleOutput::endEntry() {
    _values.endEntry();
    _places.pop_back();
}

void SampleOutput::valueRead(FieldIndex field, EntryId entry, const FieldValue& value) {
    if (!_chosen.has(field)) {
        return;
    }
    if (_form.format == DecodeFormat::Json) {
        writeJson(_fields[field], entry, value);
    } else {
        writeCsv(_fields[field], entry, value);
    }
}

void SampleOutput::writeJson(const FieldInfo& field, EntryId entry, const FieldValue& value) {
    _lines += _start;
    appendJsonString(_lines, field.name);
    _lines += R"(,"index":)";
    _lines += entry != kNoEntry ? std::to_string(_places.back()) : "null";
    _lines += R"(,"entry":)";
    if (entry != kNoEntry) {
        appendJsonString(_lines, _entries.words(entry));
    } else {
        _lines += "null";
    }
    _lines += R"(,"raw":)";
    _lines += value.raw ? std::to_string(*value.raw) : "null";
    _lines += R"(,"value":)";
    const PropertyList number = numberOf(value);
    appendJson(_lines, number.isNull() ? value.shown : number);
    _lines += R"(,"unit":)";
    if (const auto unit = unitOf(value, field); !unit.empty()) {
        appendJsonString(_lines, unit);
    } else {
        _lines += "null";
    }
    _lines += "}\n";
}

void SampleOutput::writeCsv(const FieldInfo& field, EntryId entry, const FieldValue& value) {
    _lines += _start;
    _lines += field.name;
    _lines += ',';
    if (entry != kNoEntry) {
        _lines += std::to_string(_places.back());
        _lines += ',';
        appendCsvCell(_lines, _entries.words(entry));
    } else {
        _lines += ',';
    }
    _lines += ',';
    _lines += value.raw ? std::to_string(*value.raw) : "";
    _lines += ',';
    appendCsvCell(_lines, bareText(value));
    _lines += ',';
    appendCsvCell(_lines, unitOf(value, field));
    _lines += '\n';
}

PropertyList numberOf(const FieldValue& value) {
    if (!std::isfinite(value.number)) {
        return {};
    }
    const DisplayNumber* shown = value.shown.displayNumber();
    return shown != nullptr && !shown->isReal() ? PropertyList::integer(shown->integer())
                                                : PropertyList::real(value.number);
}

std::string bareText(const FieldValue& value) {
    const PropertyList number = numberOf(value);
    if (number.isNull()) {
        return textOfValue(value.shown);
    }
    std::string text;
    appendJson(text, number);
    return text;
}

std::string_view unitOf(const FieldValue& value, const FieldInfo& field) {
    if (!std::isfinite(value.number)) {
        return {};
    }
    if (const DisplayNumber* shown = value.shown.displayNumber()) {
        return shown->unit().empty() ? std::string_view(field.unit) : shown->unit();
    }
    // A text of an object stream: a number, and maybe a per cent sign or a blank and a word.
    const Text* text = value.shown.text();
    const std::string_view all = text != nullptr ? text->view() : std::string_view();
    const std::size_t blank = all.find(' ');
    return blank != std::string_view::npos ? all.substr(blank + 1)
                                           : all.substr(all.size() - (all.ends_with('%') ? 1 : 0));
}

} // namespace pallax
