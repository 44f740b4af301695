#include "decoding/DisplayOutput.h"

#include "text/Csv.h"

#include <cmath>

namespace pallax {

namespace {

constexpr std::string_view kHeader = "time,path,value,number,unit\n";
constexpr std::string_view kNoCells = ",,";

std::string cellsOf(const PropertyList& value) {
    const std::string text = textOfValue(value);
    std::string cells;
    appendCsvCell(cells, text);
    cells += ',';
    if (const DisplayNumber* number = value.displayNumber()) {
        appendBareNumber(cells, *number);
        cells += ',';
        appendCsvCell(cells, number->unit());
        return cells;
    }
    if (value.integer() || std::isfinite(value.real().value_or(NAN))) {
        cells += text;
    }
    cells += ',';
    return cells;
}

} // namespace

std::string textOfValue(const PropertyList& value) {
    std::string text;
    if (value.appendString(text)) {
        return text;
    }
    appendJson(text, value);
    const bool quoted = text.front() == '"'; // base64 or a date, which hold nothing escaped
    return quoted ? text.substr(1, text.size() - 2) : text;
}

void JsonOutput::show(const DisplayMoment& moment, const PropertyList& display) {
    std::string& text = _output.text();
    if (_every == Every::End) {
        appendJson(text, display, _numbers);
    } else {
        text += _every == Every::Tick ? "{\"tick\":" : "{\"packet\":";
        text += std::to_string(moment.number);
        text += ",\"time\":\"";
        text += isoTimeText(moment.time);
        text += "\",\"display\":";
        appendJson(text, display, _numbers);
        text += '}';
    }
    text += '\n';
    _output.lineDone();
}

CsvOutput::CsvOutput(Output& output, bool withHeader, Names names)
    : _output(output), _names(names) {
    if (withHeader) {
        _output.text().append(names == Names::Column ? "recording," : "").append(kHeader);
    }
}

void CsvOutput::nameRecording(std::string_view name) {
    if (_names == Names::Column) {
        _name.clear();
        appendCsvCell(_name, name);
        _name += ',';
    }
}

void CsvOutput::show(const DisplayMoment& moment, const PropertyList& display) {
    _start = _name;
    _start.append(isoTimeText(moment.time)).append(",");
    _difference.compare(display, *this);
}

void CsvOutput::changed(std::string_view path, DisplayDifference::Leaf& leaf,
                        const PropertyList& value) {
    std::string cells = cellsOf(value);
    if (leaf.written != cells) {
        writeRow(path, cells);
        leaf.written = std::move(cells);
    }
}

void CsvOutput::removed(std::string_view path, DisplayDifference::Leaf& /*leaf*/) {
    writeRow(path, kNoCells);
}

void CsvOutput::writeRow(std::string_view path, std::string_view cells) {
    std::string& text = _output.text();
    text += _start;
    appendCsvCell(text, path);
    text += ',';
    text += cells;
    text += '\n';
    _output.lineDone();
}

} // namespace pallax
