#include "cli/DisplayOutput.h"

#include "app/tree/PallaxModelNode.h"
#include "app/tree/ShownEntries.h"
#include "cli/DisplayJson.h"
#include "platform/Printable.h"

#include <cmath>
#include <tuple>

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

/// The number as its text shows it, without padding and plus sign; a hexadecimal one decimal.
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

CsvOutput::CsvOutput(Output& output) : _output(output) {
    _output.text() += kHeader;
}

void CsvOutput::show(const DisplayMoment& moment, const PropertyList& display) {
    ++_display;
    _time = isoTimeText(moment.time);
    showValue("/", display);
    for (auto at = _shown.begin(); at != _shown.end();) {
        if (at->second.display == _display) {
            ++at;
            continue;
        }
        writeRow(at->first.first, kNoCells);
        at = _shown.erase(at);
    }
}

/// Walks the values as the display tree does, which keeps only texts.
void CsvOutput::showValue(const std::string& path, const PropertyList& value) {
    if (const DictionaryRef dictionary = value.dictionary()) {
        for (const ShownEntry& entry : shownEntries(*dictionary)) {
            showValue(childPath(path, entry.name), *entry.value);
        }
    } else if (const ArrayRef array = value.array()) {
        int number = 0;
        for (const PropertyList& element : *array) {
            if (!element.isNull()) {
                showValue(childPath(path, std::to_string(number++)), element);
            }
        }
    } else if (!value.isNull()) {
        showLeaf(path, value);
    }
}

void CsvOutput::showLeaf(const std::string& path, const PropertyList& value) {
    std::pair<std::string, int> key(path, 0);
    auto [shown, isNew] = _shown.try_emplace(key);
    while (!isNew && shown->second.display == _display) {
        ++key.second;
        std::tie(shown, isNew) = _shown.try_emplace(key);
    }
    shown->second.display = _display;
    std::string cells = cellsOf(value);
    if (isNew || shown->second.cells != cells) {
        writeRow(path, cells);
        shown->second.cells = std::move(cells);
    }
}

void CsvOutput::writeRow(std::string_view path, std::string_view cells) {
    std::string& text = _output.text();
    text += _time;
    text += ',';
    appendCell(text, path);
    text += ',';
    text += cells;
    text += '\n';
    _output.lineDone();
}

} // namespace pallax
