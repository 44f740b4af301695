#include "timeline/FieldTable.h"

#include "fields/Reference.h"
#include "platform/RecordedTechnology.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

std::string keyIn(std::string_view section, std::string_view key) {
    std::string both(section);
    both.append("\n").append(key);
    return both;
}

} // namespace

FieldTable::FieldTable(const RecordedTechnology& technology, const Resources& resources)
    : _technology(technology.commandName) {
    const MutedSystemLog muted; // making records is logged
    const TechnologyReference reference = gatherReference(technology, resources);
    _isObjectStream = codesOf(reference).empty();
    const FieldRegistry registry(reference);
    for (const FieldInfo& field : registry.fields()) {
        (void)add(field);
    }
}

std::optional<FieldIndex> FieldTable::named(std::string_view name) const {
    const auto found = _byName.find(std::string(name));
    return found != _byName.end() ? std::optional(found->second) : std::nullopt;
}

std::optional<FieldIndex> FieldTable::atPath(std::string_view path) const {
    const auto found = _byPath.find(std::string(path));
    return found != _byPath.end() ? std::optional(found->second) : std::nullopt;
}

std::span<const FieldIndex> FieldTable::underKey(std::string_view section,
                                                 std::string_view key) const {
    if (_isObjectStream) {
        const auto found = _byPath.find(std::string(key));
        return found != _byPath.end() ? std::span(&found->second, 1)
                                      : std::span<const FieldIndex>();
    }
    const auto found = _byKey.find(keyIn(section, key));
    return found != _byKey.end() ? std::span<const FieldIndex>(found->second)
                                 : std::span<const FieldIndex>();
}

std::span<const FieldIndex> FieldTable::ofSeveral(const Sample& sample) {
    if (sample.id < _rows.size() && !_rows[sample.id].empty()) {
        return _rows[sample.id];
    }
    if (!_isObjectStream || sample.id >= kMostPaths) {
        return {};
    }
    const auto found = _byPath.find(std::string(sample.field.key));
    const FieldIndex index =
        found != _byPath.end() ? found->second : add(infoOfPath(sample.field.key));
    addToRow(sample.id, index);
    return _rows[sample.id];
}

void FieldTable::addToRow(FieldId row, FieldIndex index) {
    if (row >= _rows.size()) {
        _rows.resize(row + std::size_t{1});
        _single.resize(_rows.size(), kSeveral);
    }
    _rows[row].push_back(index);
    _single[row] = _rows[row].size() == 1 ? index : kSeveral;
}

FieldIndex FieldTable::add(FieldInfo info) {
    const auto index = static_cast<FieldIndex>(_fields.size());
    for (const FieldId row : info.rows) {
        addToRow(row, index);
    }
    _byName.emplace(info.name, index);
    _byPath.emplace(info.path, index);
    if (!info.isInList) {
        _byKey[keyIn(info.section, info.key)].push_back(index);
    }
    _identifies.push_back(info.identifies);
    _fields.push_back(std::move(info));
    return index;
}

/// "ifx.serving_cell.rx_level" for "/Serving Cell/Rx Level". A name that another path has gets a
/// number.
FieldInfo FieldTable::infoOfPath(std::string_view path) const {
    FieldInfo info;
    info.name = _technology;
    info.path = path;
    info.kind = FieldInfo::Kind::Text;
    for (std::size_t start = 1; start <= path.size();) {
        const std::size_t end = std::min(path.find('/', start), path.size());
        const std::string_view part = path.substr(start, end - start);
        if (part == kEntryName) {
            info.isInList = true;
        } else {
            info.section = info.section.empty() ? std::string(part) : info.section;
            info.key = part;
            info.name.append(".").append(fieldWord(part));
        }
        start = end + 1;
    }
    const std::string name = info.name;
    for (int number = 2; _byName.contains(info.name); ++number) {
        info.name = name + "_" + std::to_string(number);
    }
    return info;
}

} // namespace pallax
