#include "LogGenerator/C2K/C2KLogGenerator.h"

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/EVDOActiveSet.h"
#include "LogGenerator/C2K/EVDOStatus.h"
#include "LogGenerator/C2K/FingerC2I.h"
#include "LogGenerator/C2K/ForwardDataRate.h"
#include "LogGenerator/C2K/LookupDisplay.h"
#include "LogGenerator/C2K/OneXStatus.h"
#include "LogGenerator/C2K/OneXSystemIdentity.h"
#include "LogGenerator/C2K/OneXTrafficErrors.h"
#include "LogGenerator/C2K/ReverseDataRate.h"
#include "LogGenerator/KeyFrame.h"
#include "LogGenerator/LogPacket.h"
#include "platform/Clock.h"
#include "platform/Resources.h"
#include "platform/SystemLog.h"
#include "plist/DeepCopy.h"

#include <algorithm>
#include <array>

namespace pallax {

namespace {

/// In the order of the codes in the start command.
constexpr auto kCodes = std::to_array<const CodeLayout*>({
    &kFingerC2I,
    &kEVDOStatus,
    &kForwardDataRate,
    &kEVDOActiveSet,
    &kOneXStatus,
    &kOneXTrafficErrors,
    &kReverseDataRate,
    &kOneXSystemIdentity,
});

constexpr std::string_view kSorted = "_sorted";

/// The keys of the state that are not running values.
constexpr auto kCommonKeys = std::to_array<std::string_view>(
    {"Template", "Display", "Lookup", "ExtraInfo", "DisplayState", "History"});

/// The dictionary under a key of the state, or null.
DictionaryRef dictionaryUnder(std::string_view key, const Dictionary& state) {
    const PropertyList* found = state.find(key);
    return found != nullptr ? found->dictionary() : nullptr;
}

using PlaceRead = LookupDisplay::PlaceRead;

/// Notes the ages of the places below the branch at `path`.
void noteAges(const DictionaryRef& branch, const std::string& path,
              const std::vector<PlaceRead>& places, SectionAges& ages) {
    for (const Dictionary::Entry& entry : *branch) {
        const std::string here = path + "/" + entry.key.string();
        bool isPlace = false;
        for (const PlaceRead& each : places) {
            if (each.place.display == branch && each.place.key == entry.key) {
                ages.note(here, each.time);
                isPlace = true;
            }
        }
        if (const DictionaryRef below = entry.value.dictionary(); below != nullptr && !isPlace) {
            noteAges(below, here, places, ages);
        }
    }
}

} // namespace

C2KLogGenerator::C2KLogGenerator(const GeneratorEnvironment& environment)
    : ZORLogGenerator(environment), _display(std::make_unique<LookupDisplay>(kCodes)) {}

C2KLogGenerator::~C2KLogGenerator() = default;

std::unique_ptr<LogGenerator> C2KLogGenerator::generator(const GeneratorEnvironment& environment) {
    return std::make_unique<C2KLogGenerator>(environment);
}

PropertyList C2KLogGenerator::getStartCommand() const {
    Array logCodes;
    for (const CodeLayout* code : kCodes) {
        logCodes.push_back(PropertyList::integer(code->logCode));
    }
    return Dictionary{{"SetState", "Streaming"}, {"SetZorellLogCodes", std::move(logCodes)}};
}

void C2KLogGenerator::processTemplate(const Dictionary& templateDictionary,
                                      const DictionaryRef& storeDisplayIntoDict,
                                      Dictionary& storeLookupIntoDict) {
    for (const Dictionary::Entry& entry : templateDictionary) {
        if (!entry.hasStringKey) {
            continue; // not shown, and not usable as a place
        }
        if (const DictionaryRef section = entry.value.dictionary()) {
            const auto display = std::make_shared<Dictionary>();
            processTemplate(*section, display, storeLookupIntoDict);
            storeDisplayIntoDict->set(entry.key, display);
        } else if (const auto text = entry.value.string()) {
            if (*text == kSorted) {
                storeDisplayIntoDict->set(entry.key, Text::fixed(kSorted));
            } else {
                storeDisplayIntoDict->set(entry.key, Text::fixed(""));
                addLookupPlace(*text, entry.key, storeDisplayIntoDict, storeLookupIntoDict);
            }
        }
    }
    systemLog(LogPriority::Warning, "Processing the template");
}

PropertyList C2KLogGenerator::getDisplayFromState(Dictionary& state) const {
    if (const PropertyList* display = state.find("Display")) {
        return *display;
    }
    DictionaryRef templateDictionary = dictionaryUnder("Template", state);
    if (templateDictionary == nullptr) {
        const auto loaded = environment().resources.propertyList("C2KTemplate");
        templateDictionary = loaded ? loaded->dictionary() : nullptr;
        if (templateDictionary == nullptr) {
            systemLog(LogPriority::Error, "Cannot load C2K template for display");
            return {};
        }
        state.setFixed("Template", templateDictionary);
    }
    const auto display = std::make_shared<Dictionary>();
    const auto lookup = std::make_shared<Dictionary>();
    processTemplate(*templateDictionary, display, *lookup);
    state.setFixed("Display", display);
    state.setFixed("Lookup", lookup);
    state.setFixed("ExtraInfo", Dictionary());
    return display;
}

void C2KLogGenerator::updateState(Dictionary& state, Bytes data) {
    (void)getDisplayFromState(state);
    updateFromLog(data, dictionaryUnder("Lookup", state), state);
}

void C2KLogGenerator::updateFromLog(Bytes packet, const DictionaryRef& lookup, Dictionary& state) {
    if (packet.size() < LogRecord::kHeaderLength) { // the length includes the prefix
        return;
    }
    const LogRecord record(LogPacketStripPrefix(packet));
    const std::uint8_t type = record.u8(0);
    if (type != LogRecord::kStandardType) {
        systemLog(LogPriority::Error, "Invalid log type: %x. Dropping.", type); // it is not dropped
    }
    const LogCode logCode = LogPacketGetLogCode(record);
    const auto* code =
        std::find_if(kCodes.begin(), kCodes.end(),
                     [logCode](const CodeLayout* each) { return each->logCode == logCode; });
    if (code == kCodes.end()) {
        return;
    }
    if ((*code)->accepts(**code, record)) {
        _display->setPacketTime(environment().clock.now());
        _display->take(static_cast<std::size_t>(code - kCodes.begin()), record, lookup, state);
    }
    capture(record.bytes());
}

void C2KLogGenerator::bringDisplayUpToDate() {
    _display->bringUpToDate();
}

SectionAges C2KLogGenerator::agesIn(const Dictionary& state) const {
    SectionAges ages;
    if (const DictionaryRef display = dictionaryUnder("Display", state)) {
        noteAges(display, {}, _display->placesRead(), ages);
    }
    return ages;
}

void C2KLogGenerator::addTo(KeyFrame& keyFrame, const Dictionary& state) const {
    const DictionaryRef display = dictionaryUnder("Display", state);
    if (display == nullptr) {
        return;
    }
    keyFrame.display = deepCopy(display);
    for (const Dictionary::Entry& entry : state) {
        if (std::find(kCommonKeys.begin(), kCommonKeys.end(), entry.key.view()) ==
            kCommonKeys.end()) {
            keyFrame.running.set(entry.key, deepCopy(entry.value));
        }
    }
    keyFrame.records.push_back({_display->times(), _display->memory().remembered});
}

void C2KLogGenerator::resume(Dictionary& state, const KeyFrame& from) {
    if (from.display.isNull()) {
        return;
    }
    // The places of the lookup table point into this display, so it gets the content in place.
    copyInto(getDisplayFromState(state), from.display);
    for (const Dictionary::Entry& entry : from.running) {
        state.set(entry.key, deepCopy(entry.value));
    }
    _display->usePlacesOf(dictionaryUnder("Lookup", state)); // for the ages
    _display->times() = from.records.front().times;
    _display->memory().remembered = from.records.front().remembered;
}

void C2KLogGenerator::setSampleSink(SampleSink* sink) {
    _display->setSink(sink);
}

PropertyList C2KLogGenerator::generateLogUsingState(Dictionary& state) {
    bringDisplayUpToDate();
    PropertyList display = getDisplayFromState(state);
    handOverCapture(state);
    updateHistoryInState(state, environment().clock);
    return display;
}

bool C2KLogGenerator::keepsDisplay(const Dictionary& state) const {
    return ZORLogGenerator::keepsDisplay(state) && dictionaryUnder("Lookup", state) == nullptr;
}

std::span<const CodeLayout* const> C2KLogGenerator::layouts() {
    return kCodes;
}

} // namespace pallax
