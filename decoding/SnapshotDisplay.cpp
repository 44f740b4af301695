#include "decoding/SnapshotDisplay.h"

#include "LogGenerator/Technologies/Technologies.h"
#include "host/Snapshot.h"
#include "plist/PropertyListCodec.h"

#include <memory>
#include <vector>

namespace pallax {

namespace {

/// Shows what a snapshot holds. Its messages are not from a modem: those that are not as
/// host/Snapshot makes them are ignored.
class SnapshotGenerator final : public LogGenerator {
public:
    SnapshotGenerator(const GeneratorEnvironment& environment, SnapshotDisplays displays)
        : LogGenerator(environment), _displays(displays) {}

    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override { return display(state); }
    bool keepsDisplay(const Dictionary& /*state*/) const override { return false; }
    PropertyList getStartCommand() const override { return Dictionary{{"SetState", "Streaming"}}; }
    /// A snapshot of a snapshot holds nothing.
    PropertyList getSaveContentsFromState(const Dictionary& /*state*/) const override {
        return Array();
    }

private:
    void addDisplayTo(Dictionary& all, const Dictionary& message, const PropertyList& display);

    SnapshotDisplays _displays;
};

PropertyList valueAt(const Dictionary& message, std::string_view key) {
    const PropertyList* value = message.find(key);
    return value != nullptr ? *value : PropertyList();
}

void SnapshotGenerator::updateState(Dictionary& state, Bytes data) {
    const PropertyListResult object = parsePropertyList(data);
    const DictionaryRef message = object ? object->dictionary() : nullptr;
    if (!message) {
        return;
    }
    const PropertyList content = valueAt(*message, kSnapshotDisplay);
    if (_displays == SnapshotDisplays::OneByOne) {
        state.setFixed("Display", content);
        return;
    }
    const DictionaryRef before = valueAt(state, "Display").dictionary();
    Dictionary all = before ? *before : Dictionary();
    addDisplayTo(all, *message, content);
    state.setFixed("Display", std::move(all));
}

void SnapshotGenerator::addDisplayTo(Dictionary& all, const Dictionary& message,
                                     const PropertyList& display) {
    if (all.empty()) {
        all.setFixed("Snapshot", Dictionary{{"Saved", valueAt(message, kSnapshotSaved)},
                                            {"Description", valueAt(message, kSnapshotDescription)},
                                            {"Note", std::string(kSharedSections)}});
    }
    const std::string title = valueAt(message, kSnapshotTitle).string().value_or("");
    std::string name = title;
    for (int number = 2; all.contains(name); ++number) { // two in one second
        name = title + ", " + std::to_string(number);
    }
    all.set(Text(name), display);
}

template <SnapshotDisplays kDisplays>
std::unique_ptr<LogGenerator> makeGenerator(const GeneratorEnvironment& environment) {
    return std::make_unique<SnapshotGenerator>(environment, kDisplays);
}

template <SnapshotDisplays kDisplays>
std::span<const Technology> withSnapshots() {
    static const std::vector<Technology> all = [] {
        std::vector<Technology> known(technologies().begin(), technologies().end());
        known.push_back({kSnapshotTechnology.identifier, &makeGenerator<kDisplays>});
        return known;
    }();
    return all;
}

} // namespace

std::span<const Technology> technologiesWithSnapshots(SnapshotDisplays displays) {
    return displays == SnapshotDisplays::OneByOne ? withSnapshots<SnapshotDisplays::OneByOne>()
                                                  : withSnapshots<SnapshotDisplays::Together>();
}

} // namespace pallax
