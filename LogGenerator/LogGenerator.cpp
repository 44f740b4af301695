#include "LogGenerator/LogGenerator.h"

#include "LogGenerator/KeyFrame.h"
#include "LogGenerator/Records/Exceptions.h"
#include "platform/Clock.h"
#include "platform/SystemLog.h"

namespace pallax {

namespace {

/// A history entry of the current state; it ends before the first missing value.
Dictionary historyEntry(const Dictionary& state, const Clock& clock) {
    Dictionary entry;
    for (const std::string_view key : {"DisplayState", "Display", "ExtraInfo"}) {
        const PropertyList* value = state.find(key);
        if (value == nullptr || value->isNull()) {
            return entry;
        }
        entry.setFixed(key, value->shallowCopy());
    }
    const std::string date = dateText(dateOf(clock.now()));
    entry.setFixed("Date", date);
    entry.setFixed("Description", formatText("Snapshot (%@)", {date}));
    return entry;
}

} // namespace

LogGenerator::LogGenerator(const GeneratorEnvironment& environment) : _environment(environment) {
    systemLog(LogPriority::Warning, "Creating Log object: %p", static_cast<const void*>(this));
}

void LogGenerator::updateState(Dictionary& /*state*/, Bytes /*data*/) {
    throw UnrecognisedOperation("updateState:withData:");
}

PropertyList LogGenerator::generateLogUsingState(Dictionary& /*state*/) {
    throw UnrecognisedOperation("generateLogUsingState:");
}

PropertyList LogGenerator::display(const Dictionary& state) {
    bringDisplayUpToDate();
    const PropertyList* display = state.find("Display");
    return display != nullptr ? *display : PropertyList();
}

SectionAges LogGenerator::sectionAges(const Dictionary& state) {
    bringDisplayUpToDate();
    return agesIn(state);
}

SectionAges LogGenerator::agesIn(const Dictionary& /*state*/) const {
    return {};
}

KeyFrame LogGenerator::keyFrame(const Dictionary& state) {
    bringDisplayUpToDate();
    KeyFrame keyFrame;
    addTo(keyFrame, state);
    return keyFrame;
}

bool LogGenerator::keepsDisplay(const Dictionary& state) const {
    return state.find("Display") != nullptr;
}

PropertyList LogGenerator::getStartCommand() const {
    throw UnrecognisedOperation("getStartCommand");
}

PropertyList LogGenerator::getSaveContentsFromState(const Dictionary& /*state*/) const {
    throw UnrecognisedOperation("getSaveContentsFromState:");
}

void LogGenerator::updateHistoryInState(Dictionary& state, const Clock& clock) {
    const PropertyList* found = state.find("History");
    ArrayRef history = found != nullptr ? found->array() : nullptr;
    if (history == nullptr) {
        history = std::make_shared<Array>();
        state.setFixed("History", history);
    } else if (history->size() >= kHistoryLength) {
        const auto surplus = history->size() - (kHistoryLength - 1);
        history->erase(history->begin(), history->begin() + static_cast<std::ptrdiff_t>(surplus));
    }
    history->emplace_back(historyEntry(state, clock));
}

Array LogGenerator::historyOf(const Dictionary& state) {
    const PropertyList* found = state.find("History");
    const ArrayRef history = found != nullptr ? found->array() : nullptr;
    return history != nullptr ? *history : Array();
}

std::unique_ptr<LogGenerator>
LogGenerator::generatorFromTechnology(const PropertyList& technology,
                                      std::span<const Technology> technologies,
                                      const GeneratorEnvironment& environment) {
    const auto identifier = technology.string();
    for (const Technology& row : technologies) {
        if (identifier == row.identifier) {
            return row.generator(environment);
        }
    }
    return nullptr;
}

} // namespace pallax
