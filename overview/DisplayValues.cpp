#include "overview/DisplayValues.h"

#include "app/tree/ShownEntries.h"
#include "platform/RecordedTechnology.h"
#include "platform/Resources.h"

#include <charconv>
#include <map>
#include <string>

namespace pallax {

namespace {

/// The keys of a dictionary that are strings.
template <class Visit>
void forEachKey(const PropertyList& display, const Visit& visit) {
    if (const DictionaryRef entries = display.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            if (entry.hasStringKey && entry.key.view() != kSortedKey) {
                visit(entry.key.view(), entry.value);
            }
        }
    }
}

/// The PN offset in "1;461"; nothing for other names.
std::optional<std::int64_t> pilotOf(std::string_view name) {
    const std::size_t separator = name.find(';');
    if (separator == std::string_view::npos) {
        return std::nullopt;
    }
    std::int64_t pilot = 0;
    const char* const end = name.data() + name.size();
    const auto read = std::from_chars(name.data() + separator + 1, end, pilot);
    return read.ec == std::errc() && read.ptr == end ? std::optional(pilot) : std::nullopt;
}

class DisplayWalk {
public:
    DisplayWalk(const FieldTable& fields, SampleSink& sink) : _fields(fields), _sink(sink) {}

    void walk(const PropertyList& value) {
        const auto field = _fields.atPath(_path);
        if (field && _fields[*field].kind == FieldInfo::Kind::Object) {
            give(SampleValue::object(value));
        } else if (const ArrayRef elements = value.array()) {
            walkElements(*elements);
        } else if (const DictionaryRef entries = value.dictionary()) {
            entries->contains(kSortedKey) ? walkPilots(value) : walkKeys(value);
        } else {
            giveText(value.string().value_or(value.description()));
        }
    }

private:
    void walkKeys(const PropertyList& value) {
        forEachKey(value, [this](std::string_view key, const PropertyList& child) {
            walkChild(key, child);
        });
    }

    void walkPilots(const PropertyList& value) {
        _sink.beginList({_path, nullptr, value.dictionary()->size()});
        std::size_t index = 0;
        forEachKey(value, [&](std::string_view key, const PropertyList& child) {
            _sink.beginEntry(index++, pilotOf(key).value_or(0));
            walkChild(kEntryName, child);
            _sink.endEntry();
        });
        _sink.endList();
    }

    void walkElements(const Array& elements) {
        _sink.beginList({_path, nullptr, elements.size()});
        std::size_t index = 0;
        for (const PropertyList& element : elements) {
            _sink.beginEntry(index++, 0);
            walkChild(kEntryName, element);
            _sink.endEntry();
        }
        _sink.endList();
    }

    void walkChild(std::string_view name, const PropertyList& value) {
        const std::size_t length = _path.size();
        _path.append("/").append(name);
        walk(value);
        _path.resize(length);
    }

    void giveText(const std::string& text) {
        if (text.empty() && !_fields.isObjectStream()) {
            return; // a row of CDMA without a value yet, or a list without entries
        }
        const auto field = _fields.atPath(_path);
        const bool hasNumber =
            _fields.isObjectStream() || (field && _fields[*field].kind == FieldInfo::Kind::Number);
        const auto number = hasNumber ? numberTextIn(text) : std::nullopt;
        give(number ? SampleValue::text(*number) : SampleValue::text(text));
    }

    /// A field of a layout has the number of one of its rows, a path of an object stream one that
    /// nothing else has.
    void give(const SampleValue& value) {
        const auto field = _fields.atPath(_path);
        Field described;
        described.key = _path;
        if (_fields.isObjectStream()) {
            const auto id = static_cast<FieldId>(_ids.size());
            _sink.sample({_ids.emplace(_path, id).first->second, described, {}, value});
        } else if (field && !_fields[*field].rows.empty()) {
            _sink.sample({_fields[*field].rows.front(), described, {}, value});
        }
    }

    const FieldTable& _fields;
    SampleSink& _sink;
    std::string _path;
    std::map<std::string, FieldId> _ids;
};

std::size_t sharedSections(const PropertyList& display, const TechnologyReference& technology) {
    std::size_t shared = 0;
    forEachKey(display, [&](std::string_view key, const PropertyList& /*section*/) {
        for (const SectionReference& section : technology.sections) {
            if (std::string_view(section.path).substr(1) == key) {
                ++shared;
                break;
            }
        }
    });
    return shared;
}

} // namespace

const RecordedTechnology& technologyOfDisplay(const PropertyList& display,
                                              const Resources& resources) {
    const RecordedTechnology* best = nullptr;
    std::size_t most = 0;
    for (const TechnologyReference& technology : gatherReference(resources)) {
        const bool isObjectStream = codesOf(technology).empty();
        const std::size_t shared = sharedSections(display, technology);
        if (best == nullptr ? isObjectStream || shared > 0 : shared > most) {
            best = technology.technology;
            most = shared;
        }
    }
    return best != nullptr ? *best : recordedTechnologies().front();
}

void giveDisplay(const PropertyList& display, Time time, const FieldTable& fields,
                 CurrentValues& values) {
    values.beginPacket({0, time});
    DisplayWalk(fields, values).walk(display);
}

} // namespace pallax
