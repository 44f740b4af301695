#pragma once

#include "LogGenerator/Records/Sample.h"
#include "fields/FieldRegistry.h"

#include <cstddef>
#include <cstdint>
#include <deque>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pallax {

class Resources;
struct RecordedTechnology;

/// The place of a field in its table.
using FieldIndex = std::uint32_t;

/// The fields of one recording: those of the technology's registry and, for an object stream, the
/// further paths of its messages in the order of arrival.
class FieldTable {
public:
    /// The most paths of an object stream that become fields.
    static constexpr std::size_t kMostPaths = 4096;

    FieldTable(const RecordedTechnology& technology, const Resources& resources);

    /// References stay valid.
    const FieldInfo& operator[](FieldIndex index) const { return _fields[index]; }
    std::size_t size() const { return _fields.size(); }
    std::optional<FieldIndex> named(std::string_view name) const;
    std::optional<FieldIndex> atPath(std::string_view path) const;
    /// Its name on the command line.
    const std::string& technology() const { return _technology; }

    /// Whether messages have paths instead of numbered rows.
    bool isObjectStream() const { return _isObjectStream; }
    /// Whether paths of an object stream may be missing because there are too many.
    bool isFull() const { return _rows.size() >= kMostPaths && _isObjectStream; }
    /// The sentence about that.
    static constexpr std::string_view kFullNote =
        "Only the first 4,096 paths of the messages are fields.";

    /// The fields that show a sample: usually one; of CDMA, one for each place.
    std::span<const FieldIndex> of(const Sample& sample) {
        if (sample.id < _single.size() && _single[sample.id] != kSeveral) {
            return {&_single[sample.id], 1};
        }
        return ofSeveral(sample);
    }
    /// The fields outside lists under that key of a section; of an object stream, at that path.
    std::span<const FieldIndex> underKey(std::string_view section, std::string_view key) const;

    /// Whether the field is part of the identity of its list's entries.
    bool identifies(FieldIndex index) const { return _identifies[index]; }

private:
    static constexpr auto kSeveral = static_cast<FieldIndex>(-1); ///< or none, or not known yet

    std::span<const FieldIndex> ofSeveral(const Sample& sample);
    void addToRow(FieldId row, FieldIndex index);
    FieldIndex add(FieldInfo info);
    FieldInfo infoOfPath(std::string_view path) const;

    std::string _technology;
    bool _isObjectStream = false;
    std::deque<FieldInfo> _fields;
    std::vector<bool> _identifies;
    std::vector<std::vector<FieldIndex>> _rows; ///< by the number of the row or path
    std::vector<FieldIndex> _single;            ///< the only one of a row: it is asked for often
    std::unordered_map<std::string, FieldIndex> _byName;
    std::unordered_map<std::string, FieldIndex> _byPath;
    std::unordered_map<std::string, std::vector<FieldIndex>> _byKey; ///< "section\nkey"
};

} // namespace pallax
