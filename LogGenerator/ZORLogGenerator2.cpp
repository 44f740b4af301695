#include "LogGenerator/ZORLogGenerator2.h"

#include "LogGenerator/KeyFrame.h"
#include "LogGenerator/LogPacket.h"
#include "platform/Clock.h"
#include "platform/Resources.h"
#include "platform/SystemLog.h"
#include "plist/DeepCopy.h"

#include <charconv>

namespace pallax {

namespace {

/// Logs the creation before the base is built, because this line comes first.
const GeneratorEnvironment& announced(const GeneratorEnvironment& environment,
                                      const ClassIndex* index) {
    systemLog(LogPriority::Error, "Creating ZORLogGenerator2 object with %p",
              static_cast<const void*>(index));
    return environment;
}

/// Notes the ages of the sections below the branch at `path`.
void noteAges(const Dictionary& branch, const std::string& path, const ClassIndex& index,
              SectionAges& ages) {
    for (const Dictionary::Entry& entry : branch) {
        const std::string here = path + "/" + entry.key.string();
        const DictionaryRef below = entry.value.dictionary();
        const ClassIndex::Numbered* owner = index.recordOf(entry.key.view());
        if (owner == nullptr || !owner->record->display().shows(entry.value)) {
            if (below != nullptr) {
                noteAges(*below, here, index, ages);
            }
            continue;
        }
        if (const auto read = owner->record->lastRead()) {
            ages.note(here, *read);
        }
        for (const Dictionary::Entry& shown : below != nullptr ? *below : Dictionary()) {
            if (const auto read = owner->record->lastRead(shown.key.view())) {
                ages.note(here + "/" + shown.key.string(), *read);
            }
        }
    }
}

std::int32_t codeOf(const std::string& decimal) {
    std::int32_t code = 0;
    (void)std::from_chars(decimal.data(), decimal.data() + decimal.size(), code);
    return code;
}

} // namespace

ZORLogGenerator2::ZORLogGenerator2(const GeneratorEnvironment& environment, Parts parts)
    : ZORLogGenerator(announced(environment, parts.cIndex.get())),
      pListName(std::move(parts.pListName)), cIndex(std::move(parts.cIndex)) {
    systemLog(LogPriority::Error, "Class Index: %ld", cIndex.use_count());
}

ZORLogGenerator2::~ZORLogGenerator2() {
    // All technologies log this text.
    systemLog(LogPriority::Warning, "ZOR_GSMLogGenerator is destructed %p",
              static_cast<const void*>(this));
}

void ZORLogGenerator2::updateState(Dictionary& state, Bytes data) {
    if (cIndex == nullptr) {
        return;
    }
    (void)getDisplayFromState(state); // every record has its section before the first dispatch
    updateWithData(data);
    capture(data);
}

void ZORLogGenerator2::updateWithData(Bytes data) {
    if (cIndex == nullptr) {
        return;
    }
    SharedPayload payload;
    const LogRecord record(LogPacketStripPrefix(data), payload);
    if (!record.has(LogRecord::kHeaderLength)) {
        systemLog(LogPriority::Warning, "Invalid data packet len=%lu expected=%lu", record.length(),
                  LogRecord::kHeaderLength);
        return;
    }
    const std::uint8_t type = record.u8(0);
    if (type != LogRecord::kStandardType && type != LogRecord::kExtendedType) {
        systemLog(LogPriority::Error, "Invalid log type: %x. Dropping.", type);
        return;
    }
    const LogCode code = LogPacketGetLogCode(record);
    const auto* subscribers = cIndex->getSubscribers(code);
    if (subscribers == nullptr) {
        return;
    }
    cIndex->setPacketTime(environment().clock.now());
    for (Base* subscriber : *subscribers) {
        subscriber->updateWithData(record, code);
    }
}

PropertyList ZORLogGenerator2::loadTemplate(Dictionary& state) const {
    if (const PropertyList* kept = state.find("Template")) {
        return *kept;
    }
    const auto loaded = environment().resources.propertyList(pListName);
    if (!loaded || loaded->dictionary() == nullptr) {
        systemLog(LogPriority::Error, "Cannot load template for display");
        return {};
    }
    state.setFixed("Template", *loaded);
    return *loaded;
}

PropertyList ZORLogGenerator2::getDisplayFromState(Dictionary& state) {
    if (cIndex == nullptr) {
        return {};
    }
    if (const PropertyList* display = state.find("Display")) {
        return *display;
    }
    const PropertyList templateObject = loadTemplate(state);
    if (templateObject.isNull()) {
        return {};
    }
    systemLog(LogPriority::Warning, "Initialized class index: %p, Self: %p",
              static_cast<const void*>(cIndex.get()), static_cast<const void*>(this));
    cIndex->status();
    const PropertyList display = processTemplate(templateObject);
    printDict(display);
    state.setFixed("Display", display);
    state.setFixed("ExtraInfo", Dictionary());
    return {};
}

PropertyList ZORLogGenerator2::processTemplate(const PropertyList& object) {
    if (cIndex == nullptr) {
        return {};
    }
    if (object.isString()) {
        return object;
    }
    if (const DictionaryRef entries = object.dictionary()) {
        const auto display = std::make_shared<Dictionary>();
        for (const Dictionary::Entry& entry : *entries) {
            if (!entry.hasStringKey) {
                systemLog(LogPriority::Error, "Dictionary Key is not a string?");
                continue;
            }
            PropertyList value = processTemplate(entry.value);
            if (Base* record = cIndex->getClass(entry.key.view())) {
                record->updateSectionRef(value);
            }
            if (!value.isNull()) { // a dictionary cannot contain null
                display->set(entry.key, std::move(value));
            }
        }
        return display;
    }
    if (const ArrayRef elements = object.array()) {
        const auto list = std::make_shared<Array>();
        for (const PropertyList& element : *elements) {
            if (PropertyList value = processTemplate(element); !value.isNull()) {
                list->push_back(std::move(value));
            }
        }
        return list;
    }
    systemLog(LogPriority::Error, "Received an object of unknown type");
    systemLog(LogPriority::Warning, "Processing the template");
    return {};
}

void ZORLogGenerator2::printDict(const PropertyList& object) {
    if (const DictionaryRef entries = object.dictionary()) {
        for (const Dictionary::Entry& entry : *entries) {
            printDict(entry.value);
        }
    } else if (const ArrayRef elements = object.array()) {
        for (const PropertyList& element : *elements) {
            printDict(element);
        }
    } else if (!object.isString()) {
        systemLog(LogPriority::Error, "Received an object of unknown type");
    }
}

PropertyList ZORLogGenerator2::generateLogUsingState(Dictionary& state) {
    if (cIndex == nullptr) {
        return {};
    }
    bringDisplayUpToDate();
    PropertyList display = getDisplayFromState(state);
    handOverCapture(state);
    updateHistoryInState(state, environment().clock);
    return display;
}

void ZORLogGenerator2::bringDisplayUpToDate() {
    if (cIndex != nullptr) {
        cIndex->bringDisplayUpToDate();
    }
}

SectionAges ZORLogGenerator2::agesIn(const Dictionary& state) const {
    SectionAges ages;
    const PropertyList* display = state.find("Display");
    const DictionaryRef root = display != nullptr ? display->dictionary() : nullptr;
    if (cIndex != nullptr && root != nullptr) {
        noteAges(*root, {}, *cIndex, ages);
    }
    return ages;
}

void ZORLogGenerator2::addTo(KeyFrame& keyFrame, const Dictionary& state) const {
    const PropertyList* display = state.find("Display");
    if (cIndex == nullptr || display == nullptr) {
        return;
    }
    keyFrame.display = deepCopy(*display);
    for (const auto& [record, firstRow] : cIndex->records()) {
        keyFrame.records.push_back({record->display().times(), record->memory().remembered});
    }
}

void ZORLogGenerator2::resume(Dictionary& state, const KeyFrame& from) {
    if (cIndex == nullptr || from.display.isNull()) {
        return;
    }
    (void)getDisplayFromState(state); // as for a first packet: gives the records their sections
    if (const PropertyList* display = state.find("Display")) {
        copyInto(*display, from.display);
    }
    for (std::size_t index = 0; index < from.records.size(); ++index) {
        LayoutRecord& record = *cIndex->records().at(index).record;
        record.display().times() = from.records[index].times;
        record.memory().remembered = from.records[index].remembered;
    }
}

void ZORLogGenerator2::setSampleSink(SampleSink* sink) {
    if (cIndex != nullptr) {
        cIndex->setSink(sink);
    }
}

PropertyList ZORLogGenerator2::getStartCommand() const {
    if (cIndex == nullptr) {
        return {};
    }
    constexpr auto kFirstExtraCode = static_cast<std::int32_t>(kExtendedLogCodes);
    Array logCodes;
    Array extraCodes;
    for (const std::string& decimal : cIndex->getAllLogCodes()) {
        const std::int32_t code = codeOf(decimal);
        if (code >= kFirstExtraCode) {
            extraCodes.push_back(PropertyList::integer(code - kFirstExtraCode));
        } else {
            logCodes.push_back(PropertyList::integer(code));
        }
    }
    return Dictionary{{"SetState", "Streaming"},
                      {"SetZorellLogCodes", std::move(logCodes)},
                      {"SetHxExtraCodes", std::move(extraCodes)}};
}

} // namespace pallax
