#include "decoding/DisplayOutput.h"

#include "app/tree/PallaxModelNode.h"
#include "app/tree/ShownEntries.h"
#include "decoding/DisplayJson.h"
#include "text/Printable.h"

#include <cmath>

namespace pallax {

namespace {

constexpr std::string_view kHeader = "time,path,value,number,unit\n";
constexpr std::string_view kNoCells = ",,";

void appendCell(std::string& out, std::string_view text) {
    if (text.find_first_of("\",\r\n") == std::string_view::npos) {
        appendValidUtf8(out, text);
        return;
    }
    std::string quoted = "\"";
    for (const char character : text) {
        quoted += character;
        if (character == '"') {
            quoted += '"';
        }
    }
    quoted += '"';
    appendValidUtf8(out, quoted);
}

/// The number as in its text, without padding and plus sign; a hexadecimal one in decimal.
void appendBareNumber(std::string& out, const DisplayNumber& number) {
    const NumberConversion& shown = number.format().conversion();
    NumberConversion bare;
    bare.wide = shown.wide;
    bare.conversion = shown.conversion;
    if (number.isReal()) {
        bare.precision = shown.precision;
        if (std::isfinite(number.real())) {
            appendConverted(out, bare, number.real());
        }
        return;
    }
    if (bare.conversion == 'x' || bare.conversion == 'X') {
        bare.conversion = 'u';
    }
    appendConverted(out, bare, number.integer());
}

std::string textOf(const PropertyList& value) {
    std::string text;
    if (value.appendString(text)) {
        return text;
    }
    appendJson(text, value);
    const bool quoted = text.front() == '"'; // base64 or a date, which hold nothing escaped
    return quoted ? text.substr(1, text.size() - 2) : text;
}

std::string cellsOf(const PropertyList& value) {
    const std::string text = textOf(value);
    std::string cells;
    appendCell(cells, text);
    cells += ',';
    if (const DisplayNumber* number = value.displayNumber()) {
        appendBareNumber(cells, *number);
        cells += ',';
        appendCell(cells, number->unit());
        return cells;
    }
    if (value.integer() || std::isfinite(value.real().value_or(NAN))) {
        cells += text;
    }
    cells += ',';
    return cells;
}

/// Compares without formatting the texts: false does not mean that they differ.
bool isSameText(const PropertyList& a, const PropertyList& b) {
    const DisplayNumber* number = a.displayNumber();
    const DisplayNumber* otherNumber = b.displayNumber();
    if (number != nullptr && otherNumber != nullptr) {
        return number->sameNumberAndFormat(*otherNumber);
    }
    return a.text() != nullptr && b.text() != nullptr && *a.text() == *b.text();
}

} // namespace

void JsonOutput::show(const DisplayMoment& moment, const PropertyList& display) {
    std::string& text = _output.text();
    if (_every == Every::End) {
        appendJson(text, display);
    } else {
        text += _every == Every::Tick ? "{\"tick\":" : "{\"packet\":";
        text += std::to_string(moment.number);
        text += ",\"time\":\"";
        text += isoTimeText(moment.time);
        text += "\",\"display\":";
        appendJson(text, display);
        text += '}';
    }
    text += '\n';
    _output.lineDone();
}

CsvOutput::CsvOutput(Output& output, bool withHeader) : _output(output) {
    if (withHeader) {
        _output.text() += kHeader;
    }
}

void CsvOutput::show(const DisplayMoment& moment, const PropertyList& display) {
    ++_display;
    _before.swap(_order);
    _order.clear();
    _time = isoTimeText(moment.time);
    _path = "/";
    showValue(display);
    for (auto at = _shown.begin(); at != _shown.end();) {
        if (at->second.display == _display) {
            ++at;
            continue;
        }
        writeRow(at->second, kNoCells);
        at = _shown.erase(at);
    }
}

/// Visits the values in the order of the display tree, which keeps only texts.
void CsvOutput::showValue(const PropertyList& value) {
    if (const DictionaryRef dictionary = value.dictionary()) {
        for (const ShownEntry& entry : shownEntries(*dictionary)) {
            showChild(entry.name, *entry.value);
        }
    } else if (const ArrayRef array = value.array()) {
        int number = 0;
        for (const PropertyList& element : *array) {
            if (!element.isNull()) {
                showChild(std::to_string(number++), element);
            }
        }
    } else if (!value.isNull()) {
        showLeaf(value);
    }
}

void CsvOutput::showChild(std::string_view name, const PropertyList& value) {
    const std::size_t length = _path.size();
    const std::size_t lengthWithoutSlashes = _path.find_last_not_of('/') + 1;
    makeChildPath(_path, name);
    showValue(value);
    _path.resize(lengthWithoutSlashes);
    _path.resize(length, '/');
}

void CsvOutput::showLeaf(const PropertyList& value) {
    const auto row = rowOfPath();
    _order.push_back(row);
    Shown& shown = row->second;
    const bool isNew = shown.display == 0;
    shown.display = _display;
    if (isNew) {
        appendCell(shown.pathCell, _path);
    } else if (isSameText(shown.value, value)) {
        return;
    }
    std::string cells = cellsOf(value);
    if (isNew || shown.cells != cells) {
        writeRow(shown, cells);
        shown.cells = std::move(cells);
    }
    shown.value = value;
}

/// The row of the next node at the path; a new one has no display yet.
CsvOutput::Rows::iterator CsvOutput::rowOfPath() {
    if (_order.size() < _before.size()) {
        const auto next = _before[_order.size()];
        if (next->first.second == 0 && next->first.first == _path &&
            next->second.display != _display) {
            return next;
        }
    }
    std::pair<std::string, int> key(_path, 0);
    auto row = _shown.try_emplace(key).first;
    while (row->second.display == _display) {
        ++key.second;
        row = _shown.try_emplace(key).first;
    }
    return row;
}

void CsvOutput::writeRow(const Shown& shown, std::string_view cells) {
    std::string& text = _output.text();
    text += _time;
    text += ',';
    text += shown.pathCell;
    text += ',';
    text += cells;
    text += '\n';
    _output.lineDone();
}

} // namespace pallax
