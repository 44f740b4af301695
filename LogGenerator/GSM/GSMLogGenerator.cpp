#include "LogGenerator/GSM/GSMLogGenerator.h"

#include "LogGenerator/KeyFrame.h"
#include "platform/Clock.h"
#include "plist/PropertyListCodec.h"
#include "text/Format.h"

#include <utility>

namespace pallax {

namespace {

constexpr int kUnknownTypeLine = 78;
constexpr int kNotDeserializedLine = 90;

// Types have the names that all property-list diagnostics use.
[[noreturn]] void throwUnknownType(const PropertyList& object) {
    throw GSMLogGenerator::InternalInconsistencyException(
        formatText("Unknown object of type %@ encountered", {object.typeName()}), kUnknownTypeLine);
}

/// Throws the exceptions of making the display form.
void requireDisplayForm(const PropertyList& object) {
    if (object.isString()) {
        return;
    }
    if (const DictionaryRef entries = object.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            requireDisplayForm(entry.value);
        }
    } else if (const ArrayRef elements = object.array()) {
        for (const PropertyList& element : *elements) {
            requireDisplayForm(element);
        }
    } else {
        throwUnknownType(object);
    }
}

/// The display form of a value in a container.
PropertyList collapsedForm(const PropertyList& object) {
    PropertyList form = GSMLogGenerator::processObject(object);
    PropertyList single = GSMLogGenerator::canCollapse(form);
    return single.isNull() ? form : single;
}

Dictionary displayForm(const Dictionary& entries) {
    Dictionary display;
    display.reserve(entries.size());
    for (const Dictionary::Entry& entry : entries) {
        if (entry.hasStringKey) {
            display.set(entry.key, collapsedForm(entry.value));
        } else {
            display.appendForeignKey(entry.key, collapsedForm(entry.value));
        }
    }
    return display;
}

Array displayForm(const Array& elements) {
    Array display;
    display.reserve(elements.size());
    bool isFirst = true;
    for (const PropertyList& element : elements) {
        PropertyList form = collapsedForm(element); // the first as well, to check its types
        if (!isFirst) {
            display.push_back(std::move(form));
        }
        isFirst = false;
    }
    return display;
}

} // namespace

GSMLogGenerator::InternalInconsistencyException::InternalInconsistencyException(
    const std::string& message, int line)
    : std::runtime_error(formatText("%@ (%s, line %d)", {message, kFile, line})), _message(message),
      _line(line) {}

std::unique_ptr<LogGenerator> GSMLogGenerator::generator(const GeneratorEnvironment& environment) {
    return std::make_unique<GSMLogGenerator>(environment);
}

GSMLogGenerator::~GSMLogGenerator() = default;

void GSMLogGenerator::updateState(Dictionary& state, Bytes data) {
    const PropertyListResult object = parsePropertyList(data);
    if (!object) {
        throw InternalInconsistencyException("Could not deserialize the object",
                                             kNotDeserializedLine);
    }
    requireDisplayForm(*object); // may throw, so before anything is stored
    take(state, *object);
    _read = environment().clock.now();
    if (_sink != nullptr) {
        _samples.give(*object, *_sink);
    }
}

void GSMLogGenerator::take(Dictionary& state, const PropertyList& object) {
    state.setFixed("DisplayState", object);
    state.setFixed("Display", displayToCome(object));
    state.setFixed("ExtraInfo", Dictionary());
}

void GSMLogGenerator::addTo(KeyFrame& keyFrame, const Dictionary& state) const {
    if (const PropertyList* object = state.find("DisplayState")) {
        keyFrame.display = *object; // which is never changed
        keyFrame.paths = _samples.paths();
        keyFrame.paths.read = _read;
    }
}

void GSMLogGenerator::resume(Dictionary& state, const KeyFrame& from) {
    if (from.display.isNull()) {
        return;
    }
    take(state, from.display);
    _read = from.paths.read;
    _samples.resume(from.paths);
}

PropertyList GSMLogGenerator::displayToCome(const PropertyList& object) {
    _unshown = object.dictionary();
    if (_unshown == nullptr) {
        return processObject(object);
    }
    _display = std::make_shared<Dictionary>();
    return _display;
}

void GSMLogGenerator::bringDisplayUpToDate() {
    if (_unshown != nullptr) {
        *_display = displayForm(*_unshown);
        _unshown = nullptr;
    }
}

SectionAges GSMLogGenerator::agesIn(const Dictionary& /*state*/) const {
    SectionAges ages;
    if (_read) {
        ages.note("/", *_read);
    }
    return ages;
}

PropertyList GSMLogGenerator::generateLogUsingState(Dictionary& state) {
    bringDisplayUpToDate();
    updateHistoryInState(state, environment().clock);
    const PropertyList* display = state.find("Display");
    return display != nullptr ? *display : PropertyList();
}

PropertyList GSMLogGenerator::getStartCommand() const {
    return Dictionary{{"SetState", "Streaming"}};
}

PropertyList GSMLogGenerator::getSaveContentsFromState(const Dictionary& state) const {
    return historyOf(state);
}

PropertyList GSMLogGenerator::processObject(const PropertyList& object) {
    if (object.isString()) {
        return object;
    }
    if (const DictionaryRef entries = object.dictionary()) {
        return displayForm(*entries);
    }
    if (const ArrayRef elements = object.array()) {
        return displayForm(*elements);
    }
    throwUnknownType(object);
}

PropertyList GSMLogGenerator::canCollapse(const PropertyList& object) {
    const DictionaryRef entries = object.dictionary();
    return entries != nullptr && entries->size() == 1 ? entries->begin()->value : PropertyList();
}

} // namespace pallax
