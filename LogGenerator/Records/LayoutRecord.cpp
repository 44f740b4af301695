#include "LogGenerator/Records/LayoutRecord.h"

#include "LogGenerator/Records/DisplayAndSink.h"
#include "platform/SystemLog.h"

#include <algorithm>

namespace pallax {

namespace {

bool isPlain(const CodeLayout& code) {
    return code.accepts == nullptr && code.logs == nullptr && !code.exactLength &&
           code.condition == nullptr &&
           std::none_of(code.lists.begin(), code.lists.end(),
                        [](const ListLayout& list) { return list.sizeCheck.has_value(); });
}

void logUnexpectedSizes(const CodeLayout& code, const LogRecord& record) {
    for (const ListLayout& list : code.lists) {
        const std::size_t counted = list.countIn(record);
        if (!list.seemsToFit(record, counted)) {
            const auto [expected, actual] = list.sizesIn(record, counted);
            systemLog(LogPriority::Error, "Unexpected log packet bytes size: expected=%d actual=%d",
                      expected, actual);
        }
    }
}

} // namespace

LayoutRecord::LayoutRecord(const RecordLayout& layout) : _layout(layout), _display(_memory) {
    FieldId row = 0;
    for (const CodeLayout& code : layout.codes) {
        _codes.push_back({code.logCode, &code, row, code.minimumLength, isPlain(code),
                          pallax::isReadLate(code), hasShapes(code)});
        _logCodes.push_back(code.logCode);
        row += static_cast<FieldId>(rowCount(code));
    }
}

void LayoutRecord::updateSectionRef(PropertyList section) {
    _display.bringUpToDate(); // the kept record belongs to the old section
    Base::updateSectionRef(std::move(section));
    _display.setSection(sectionRef());
}

void LayoutRecord::setPlace(FieldId first, const Time& packet) {
    _firstRow = first;
    _packet = &packet;
    FieldId rows = 0;
    for (const Code& code : _codes) {
        rows += static_cast<FieldId>(rowCount(*code.layout));
    }
    _display.times().setRows(first, rows);
}

std::optional<Time> LayoutRecord::lastRead(std::string_view key) const {
    const ReadTimes& times = _display.times();
    std::optional<Time> latest = times.ofKey(key);
    for (const Code& code : _codes) {
        FieldId row = _firstRow + code.firstRow;
        const auto look = [&](std::span<const Field> fields, std::span<const ListLayout> lists) {
            for (const Field& field : fields) {
                latest = std::max(latest, field.key == key ? times.ofRow(row) : std::nullopt);
                ++row;
            }
            row += static_cast<FieldId>(rowCount(lists));
        };
        look(code.layout->fields, code.layout->lists);
        for (const SubpacketLayout& subpacket : code.layout->subpackets) {
            look(subpacket.fields, subpacket.lists);
        }
    }
    return latest;
}

const LayoutRecord::Code* LayoutRecord::codeOf(LogCode logCode) const {
    const auto found = std::find_if(_codes.begin(), _codes.end(), [logCode](const Code& each) {
        return each.logCode == logCode;
    });
    if (found != _codes.end()) {
        return &*found;
    }
    return _layout.readsOtherCodes ? &_codes.front() : nullptr;
}

void LayoutRecord::updateWithData(const LogRecord& record, LogCode logCode) {
    systemLog(_layout.priority, "%s", _layout.logLine);
    const Code* code = codeOf(logCode);
    if (code == nullptr) {
        if (_layout.reportsOtherCodes) {
            logUnknownLogCode(logCode);
        }
        return;
    }
    const CodeLayout& layout = *code->layout;
    if (code->isPlain ? !record.has(code->minimumLength) : !accepts(layout, record)) {
        return;
    }
    if (_sink != nullptr) {
        _sink->beginSection(_layout.section);
    }
    if (!code->isReadLate) {
        return readNow(*code, record);
    }
    if (_sink != nullptr) {
        LayoutReader(*_sink, _memory, _firstRow + code->firstRow).read(layout, record);
    }
    _display.keep(layout, _firstRow + code->firstRow, code->hasShapes ? shapeOf(layout, record) : 0,
                  packetTime(), record);
}

bool LayoutRecord::accepts(const CodeLayout& layout, const LogRecord& record) {
    const bool accepted =
        layout.accepts != nullptr ? layout.accepts(layout, record) : isAllowed(layout, record);
    if (accepted && layout.logs != nullptr) {
        layout.logs(layout, record);
    }
    if (accepted) {
        logUnexpectedSizes(layout, record);
    }
    return accepted;
}

void LayoutRecord::readNow(const Code& code, const LogRecord& record) {
    const CodeLayout& layout = *code.layout;
    _display.bringUpToDate(); // with the entries remembered so far
    _display.times().setPacket(packetTime());
    remember(layout, record, _memory);
    const FieldId first = _firstRow + code.firstRow;
    if (_sink == nullptr) {
        LayoutReader(_display, _memory, first).read(layout, record);
    } else {
        DisplayAndSink both(_display, *_sink);
        LayoutReader<SampleSink>(both, _memory, first).read(layout, record);
    }
    if (layout.logsSection != nullptr) {
        layout.logsSection(record, sectionRef());
    }
}

} // namespace pallax
