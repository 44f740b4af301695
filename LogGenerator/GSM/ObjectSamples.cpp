#include "LogGenerator/GSM/ObjectSamples.h"

#include <algorithm>
#include <utility>

namespace pallax {

namespace {

constexpr std::string_view kAnyEntry = "*";

} // namespace

void ObjectSamples::give(const PropertyList& object, SampleSink& sink) {
    const std::vector<FieldId> before = std::exchange(_shown, {});
    _shown.reserve(before.size());
    _sink = &sink;
    _lists = 0;
    _latest = 0;
    _path.clear();
    walk(object);
    if (_shown != before) {
        removeOthers(before);
    }
}

void ObjectSamples::walk(const PropertyList& object) {
    if (const Text* text = object.text()) {
        giveText(text->view());
    } else if (const DictionaryRef entries = object.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            walkCollapsed(entry.value, entry.key.view());
        }
    } else if (const ArrayRef elements = object.array()) {
        giveList(*elements);
    }
}

/// Walks the display form: a dictionary of one entry is replaced by that entry's value.
void ObjectSamples::walkCollapsed(const PropertyList& object, std::string_view name) {
    const std::size_t length = _path.size();
    _path += '/';
    _path += name;
    const PropertyList* shown = &object;
    for (DictionaryRef only = shown->dictionary(); only != nullptr && only->size() == 1;
         only = shown->dictionary()) {
        shown = &only->begin()->value; // `object` keeps it
    }
    walk(*shown);
    _path.resize(length);
}

void ObjectSamples::giveText(std::string_view text) {
    const FieldId id = take();
    if (id == kNoField) {
        return;
    }
    const auto number = numberTextIn(text);
    _sink->sample({id, _fields[id], std::nullopt,
                   number ? SampleValue::text(*number) : SampleValue::text(text)});
}

void ObjectSamples::giveList(const Array& elements) {
    const FieldId id = take();
    if (id == kNoField) {
        return;
    }
    constexpr std::size_t kLeftOut = 1; // the display leaves the first element out
    const std::size_t count = elements.size() - std::min(kLeftOut, elements.size());
    _sink->beginList({_fields[id].key, nullptr, count});
    ++_lists;
    for (std::size_t index = 0; index < count; ++index) {
        _sink->beginEntry(index, 0);
        walkCollapsed(elements[index + kLeftOut], kAnyEntry);
        _sink->endEntry();
    }
    --_lists;
    _sink->endList();
}

FieldId ObjectSamples::take() {
    // Messages mostly repeat the paths of those before them: a tenth of the time goes to the search
    // for a path if the one that followed is not tried first.
    FieldId id = _after[_latest];
    if (id == kNoField || _fields[id].key != _path) {
        const auto found = _ids.find(std::string_view(_path));
        if (found == _ids.end() && _fields.size() == kMostPaths) {
            return kNoField;
        }
        id = found != _ids.end() ? found->second : add(_path);
        _after[_latest] = id;
    }
    _latest = id + 1;
    if (_lists == 0) {
        _shown.push_back(id);
    }
    return id;
}

FieldId ObjectSamples::add(std::string_view path) {
    const auto id = static_cast<FieldId>(_fields.size());
    _fields.emplace_back().key = _ids.emplace(path, id).first->first;
    _after.push_back(kNoField);
    return id;
}

KeyFrame::Paths ObjectSamples::paths() const {
    KeyFrame::Paths paths;
    for (const Field& field : _fields) {
        paths.known.emplace_back(field.key);
    }
    paths.shown = _shown;
    return paths;
}

void ObjectSamples::resume(const KeyFrame::Paths& paths) {
    _ids.clear();
    _fields.clear();
    _after.assign(1, kNoField);
    for (const std::string& path : paths.known) {
        (void)add(path);
    }
    _shown = paths.shown;
}

void ObjectSamples::removeOthers(const std::vector<FieldId>& before) {
    std::vector<bool> isShown(_fields.size());
    for (const FieldId id : _shown) {
        isShown[id] = true;
    }
    for (const FieldId id : before) {
        if (!isShown[id]) {
            _sink->keyRemoved(_fields[id].key);
            isShown[id] = true; // two entries may have the same path
        }
    }
}

} // namespace pallax
