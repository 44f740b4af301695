#include "timeline/Appearances.h"

#include "fields/EventFields.h"
#include "timeline/ValueReader.h"

#include <algorithm>
#include <cmath>
#include <unordered_map>
#include <unordered_set>
#include <utility>

namespace pallax {

namespace {

/// "measured_rsrp", as queries name it.
std::string_view shortName(const FieldInfo& field) {
    return std::string_view(field.name).substr(field.name.rfind('.') + 1);
}

} // namespace

class Appearances::Reader final : public ValueReader {
public:
    struct Appearance {
        FieldIndex field;
        EntryId entry;
        std::uint64_t packet;
        Time time;
        std::string text;
        bool isFirst; ///< of the field in this entry
    };

    explicit Reader(Timeline& timeline) : ValueReader(timeline), _timeline(&timeline) {}

    /// Whether `timeline` may be the one that was read: a shorter one is another.
    bool reads(const Timeline& timeline) const {
        return _timeline == &timeline && _read <= timeline.packets();
    }
    bool readOn(const MayContinue& mayContinue) {
        const std::uint64_t to = _timeline->packets();
        const bool isDone = _timeline->read(_read + 1, to, *this, mayContinue);
        _read = isDone ? to : std::max(_read, packet().number);
        return isDone;
    }
    const std::vector<Appearance>& all() const { return _all; }
    bool isFull() const { return _isCut || _all.size() >= kMost; }

private:
    /// What was seen of a field in one entry.
    struct Seen {
        PropertyList latest;
        std::unordered_set<std::string> texts;
    };

    void valueRead(FieldIndex field, EntryId entry, const FieldValue& value) override {
        if (value.isEmpty()) {
            return;
        }
        const auto [seen, isFirst] =
            _seen.try_emplace(std::uint64_t{entry} << 32U | field, Seen{value.shown, {}});
        const bool isSame = !isFirst && seen->second.latest == value.shown;
        if (isSame) {
            return;
        }
        seen->second.latest = value.shown;
        if (std::isfinite(value.number) && seen->second.texts.size() == kMostNumbers) {
            _isCut = true;
            return;
        }
        std::string text = value.text();
        if (_all.size() < kMost && seen->second.texts.insert(text).second) {
            _all.push_back(
                {field, entry, packet().number, packet().time, std::move(text), isFirst});
        }
    }

    Timeline* _timeline;
    std::uint64_t _read = 0; ///< the latest packet that was read
    std::unordered_map<std::uint64_t, Seen> _seen;
    std::vector<Appearance> _all; ///< by packet
    bool _isCut = false;          ///< a field had too many numbers
};

Appearances::Appearances() = default;
Appearances::~Appearances() = default;

bool Appearances::read(Timeline& timeline, const MayContinue& mayContinue) {
    if (_reader == nullptr || !_reader->reads(timeline)) {
        _reader = std::make_unique<Reader>(timeline);
    }
    return _reader->readOn(mayContinue);
}

bool Appearances::isFull() const {
    return _reader != nullptr && _reader->isFull();
}

std::vector<Appearances::Hit> Appearances::find(const Timeline& timeline,
                                                const Matches& matches) const {
    std::vector<Hit> hits;
    if (_reader == nullptr) {
        return hits;
    }
    for (const Event& event : timeline.events()) {
        if (matches(event.words)) {
            hits.push_back(
                {event.packet, event.time, std::string(wordOf(event.kind)), event.words, ""});
        }
    }
    std::unordered_set<EntryId> entries;
    for (const Reader::Appearance& each : _reader->all()) {
        const FieldInfo& field = timeline.fields()[each.field];
        const std::string& words = timeline.entries().words(each.entry);
        if (each.entry != kNoEntry && matches(words) && entries.insert(each.entry).second) {
            hits.push_back({each.packet, each.time, words, "", field.section});
        }
        const bool isNamed = each.isFirst && (matches(field.key) || matches(shortName(field)));
        if (isNamed || matches(each.text)) {
            hits.push_back({each.packet, each.time, field.key, each.text,
                            words.empty() ? field.section : field.section + ", " + words});
        }
    }
    std::stable_sort(hits.begin(), hits.end(),
                     [](const Hit& a, const Hit& b) { return a.packet < b.packet; });
    return hits;
}

} // namespace pallax
