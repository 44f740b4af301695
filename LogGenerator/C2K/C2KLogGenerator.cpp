#include "LogGenerator/C2K/C2KLogGenerator.h"

#include "LogGenerator/C2K/C2KLookup.h"
#include "LogGenerator/C2K/EVDOActiveSet.h"
#include "LogGenerator/C2K/EVDOStatus.h"
#include "LogGenerator/C2K/FingerC2I.h"
#include "LogGenerator/C2K/ForwardDataRate.h"
#include "LogGenerator/C2K/OneXStatus.h"
#include "LogGenerator/C2K/OneXSystemIdentity.h"
#include "LogGenerator/C2K/OneXTrafficErrors.h"
#include "LogGenerator/C2K/ReverseDataRate.h"
#include "LogGenerator/LogPacket.h"
#include "LogGenerator/Records/Description.h"
#include "platform/Resources.h"
#include "platform/SystemLog.h"

#include <algorithm>
#include <array>
#include <utility>

namespace pallax {

namespace {

/// Turns a packet into values under their lookup names; may keep running values in the state.
struct Parser {
    LogCode logCode;
    void (*parse)(const LogRecord& packet, Dictionary& state, const Dictionary& lookup);
    CodeDescription (*describe)(LogCode logCode);
    /// Whether a packet replaces all that the one before it under the code has shown, and parsing
    /// it logs nothing. Null for parsers that keep running values, whose every packet counts.
    bool (*replacesShown)(const LogRecord& packet) = nullptr;
};

/// In the order in which the start command names the codes.
constexpr auto kParsers = std::to_array<Parser>({
    {0x108A, parseFingerC2I, describeFingerC2I, isWholeFingerC2I},
    {0x1183, parseEVDOStatus, describeEVDOStatus, isWholeEVDOStatus},
    {0x1192, parseForwardDataRate, describeForwardDataRate},
    {0x12B6, parseEVDOActiveSet, describeEVDOActiveSet, isWholeEVDOActiveSet},
    {0x119C, parseOneXStatus, describeOneXStatus},
    {0x119D, parseOneXTrafficErrors, describeOneXTrafficErrors},
    {0x127E, parseReverseDataRate, describeReverseDataRate},
    {0x134F, parseOneXSystemIdentity, describeOneXSystemIdentity, isWholeOneXSystemIdentity},
});

static_assert(kParsers.size() == C2KLogGenerator::kLogCodeCount);

constexpr std::string_view kSorted = "_sorted";

/// The dictionary under a key of the state, or null.
DictionaryRef dictionaryUnder(std::string_view key, const Dictionary& state) {
    const PropertyList* found = state.find(key);
    return found != nullptr ? found->dictionary() : nullptr;
}

} // namespace

C2KLogGenerator::~C2KLogGenerator() {
    C2KLogGenerator::catchUp(); // the display outlives its generator
}

std::unique_ptr<LogGenerator> C2KLogGenerator::generator(const GeneratorEnvironment& environment) {
    return std::make_unique<C2KLogGenerator>(environment);
}

PropertyList C2KLogGenerator::getStartCommand() const {
    Array logCodes;
    for (const Parser& parser : kParsers) {
        logCodes.push_back(PropertyList::integer(parser.logCode));
    }
    return Dictionary{{"SetState", "Streaming"}, {"SetZorellLogCodes", std::move(logCodes)}};
}

void C2KLogGenerator::processTemplate(const Dictionary& templateDictionary,
                                      const DictionaryRef& storeDisplayIntoDict,
                                      Dictionary& storeLookupIntoDict) {
    for (const Dictionary::Entry& entry : templateDictionary) {
        if (!entry.hasStringKey) {
            continue; // could neither be shown nor named as a place
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
    if (packet.size() < LogRecord::kHeaderLength) { // asked of the message, prefix included
        return;
    }
    const LogRecord record(LogPacketStripPrefix(packet));
    const std::uint8_t type = record.u8(0);
    if (type != LogRecord::kStandardType) {
        systemLog(LogPriority::Error, "Invalid log type: %x. Dropping.", type); // it is not
    }
    const LogCode code = LogPacketGetLogCode(record);
    const auto* parser = std::find_if(kParsers.begin(), kParsers.end(),
                                      [code](const Parser& each) { return each.logCode == code; });
    if (parser == kParsers.end()) {
        return;
    }
    if (parser->replacesShown != nullptr && parser->replacesShown(record)) {
        Kept& kept = _kept[static_cast<std::size_t>(parser - kParsers.begin())];
        kept.packet.assign(record.bytes().begin(), record.bytes().end());
        kept.lookup = lookup;
    } else {
        const Dictionary nowhere;
        parser->parse(record, state, lookup != nullptr ? *lookup : nowhere);
    }
    capture(record.bytes());
}

void C2KLogGenerator::catchUp() {
    Dictionary noState; // what may be kept has no running values
    for (std::size_t place = 0; place < kParsers.size(); ++place) {
        if (const DictionaryRef lookup = std::exchange(_kept[place].lookup, nullptr)) {
            kParsers[place].parse(LogRecord(_kept[place].packet), noState, *lookup);
        }
    }
}

PropertyList C2KLogGenerator::generateLogUsingState(Dictionary& state) {
    catchUp();
    PropertyList display = getDisplayFromState(state);
    handOverCapture(state);
    updateHistoryInState(state, environment().clock);
    return display;
}

bool C2KLogGenerator::keepsDisplay(const Dictionary& state) const {
    return ZORLogGenerator::keepsDisplay(state) && dictionaryUnder("Lookup", state) == nullptr;
}

std::vector<CodeDescription> C2KLogGenerator::describe() {
    std::vector<CodeDescription> description;
    description.reserve(kParsers.size());
    for (const Parser& parser : kParsers) {
        description.push_back(parser.describe(parser.logCode));
    }
    return description;
}

} // namespace pallax
