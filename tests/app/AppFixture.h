#pragma once

#include "app/PallaxApp.h"
#include "tests/doubles/FakeFileSystem.h"
#include "tests/doubles/FakePreferences.h"
#include "tests/doubles/FakeToolkit.h"
#include "tests/doubles/ModelFixture.h"

#include <memory>
#include <span>
#include <string>
#include <utility>

namespace pallax::doubles {

/// Shows the state's content and saves the history. Like the generator of the object-stream modem,
/// it saves no DLF log. Its name in `kHistoryTechnologies` is "History".
class HistoryGenerator final : public FakeGenerator {
public:
    explicit HistoryGenerator(const GeneratorEnvironment& environment)
        : FakeGenerator(environment), _clock(environment.clock) {}
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment) {
        return std::make_unique<HistoryGenerator>(environment);
    }

    void updateState(Dictionary& state, Bytes data) override {
        FakeGenerator::updateState(state, data);
        state.set("DisplayState", PropertyList::data(packets.back()));
        state.set("ExtraInfo", Dictionary());
    }
    PropertyList generateLogUsingState(Dictionary& state) override {
        PropertyList shown = FakeGenerator::generateLogUsingState(state);
        updateHistoryInState(state, _clock);
        return shown;
    }
    PropertyList getSaveContentsFromState(const Dictionary& state) const override {
        const PropertyList* history = state.find("History");
        return history != nullptr ? history->shallowCopy() : PropertyList(Array());
    }

private:
    const Clock& _clock;
};

inline constexpr Technology kHistoryTechnologies[] = {{"History", &HistoryGenerator::generator}};

/// The application with a real model and fakes; the modem first answers "Fake".
class AppFixture : public ModelFixture {
protected:
    AppFixture() { model.reset(); } // the application makes its own model

    void SetUp() override {
        ModelFixture::SetUp();
        makeApp();
    }

    /// Uses the current settings.
    void makeApp() {
        PallaxApp::Surroundings surroundings{
            .toolkit = toolkit,
            .files = *usedFiles,
            .preferences = *usedPreferences,
            .queue = queue,
            .clock = clock,
            .present = present,
            .makeModel = [this](ModelObserver& application) { return makeModel(application); }};
        if (!snapshotDirectory.empty()) {
            surroundings.snapshotDirectory = snapshotDirectory;
        }
        if (!saveButtonMarker.empty()) {
            surroundings.saveButtonMarker = saveButtonMarker;
        }
        surroundings.startsAfreshByItself = startsAfresh;
        surroundings.linkChanged = linkChanged;
        app = std::make_unique<PallaxApp>(std::move(surroundings));
    }
    /// Launches the application and lets it connect.
    void launch() {
        app->applicationDidFinishLaunching();
        queue.runReady();
    }
    /// Receives a packet that changes the display to `display`, up to the next tick.
    void tick(const PropertyList& display) {
        ports.deliver({1});
        queue.runReady();
        generator().display = display;
        advance(PallaxModel::kDisplayInterval);
    }
    /// Advances the clock first, so that timers see the time at which they are due.
    void advance(std::chrono::nanoseconds duration) {
        clock.advance(duration);
        present.advance(duration);
        queue.advance(duration);
    }

    FakeNavigationStack& stack() const {
        return dynamic_cast<FakeNavigationStack&>(*app->navigationController());
    }
    PallaxPaneController& pane(std::size_t index) const {
        return dynamic_cast<PallaxPaneController&>(*stack().screens().at(index));
    }
    std::size_t depth() const { return stack().screens().size(); }
    PallaxPaneController& top() const { return pane(depth() - 1); }
    /// Opens the row of that name in the top pane.
    void openRow(const std::string& name) {
        PallaxPaneController& current = top();
        for (std::size_t row = 0; row < current.numberOfRows(); ++row) {
            if (current.pane().row(row).name == name) {
                return current.didSelectRow(row);
            }
        }
        FAIL() << "no row " << name;
    }
    /// "status" or, while loading, "status (loading)".
    static std::string statusOf(const ui::Screen& screen) {
        const auto& spinner = std::get<ui::ActivityIndicator>(screen.toolbarItems().at(0));
        const auto& label = std::get<ui::Label>(screen.toolbarItems().at(1));
        return label.text + (spinner.isSpinning ? " (loading)" : "");
    }
    static bool offersSave(const ui::Screen& screen) {
        return screen.toolbarItems().size() > 3 &&
               std::holds_alternative<ui::SaveButton>(screen.toolbarItems()[3]);
    }
    static std::string rowsOf(PallaxPaneController& shown) {
        std::string rows;
        for (std::size_t row = 0; row < shown.numberOfRows(); ++row) {
            const PaneRow text = shown.pane().row(row);
            rows += (row == 0 ? "" : " ") + text.name + (text.text ? "=" + *text.text : "");
        }
        return rows;
    }

    ManualClock present;
    FakeToolkit toolkit;
    FakeFileSystem files;
    FakePreferences preferences;
    FileSystem* usedFiles = &files;
    Preferences* usedPreferences = &preferences;
    std::span<const Technology> spoken = kFakeTechnologies;
    std::string snapshotDirectory; ///< empty: the built-in default
    std::string saveButtonMarker;  ///< empty: the built-in default
    bool startsAfresh = false;     ///< by itself
    PallaxApp::LinkChanged linkChanged;
    PallaxModel* appModel = nullptr;
    std::unique_ptr<PallaxApp> app;

private:
    std::unique_ptr<PallaxModel> makeModel(ModelObserver& application) {
        toolkit.diary.emplace_back("make model");
        auto made = std::make_unique<PallaxModel>(
            PallaxModel::Platform{.ports = ports,
                                  .telephony = telephony,
                                  .queue = queue,
                                  .timers = queue,
                                  .generators = {clock, resources, bundle, standardOutput},
                                  .technologies = spoken},
            application);
        appModel = made.get();
        return made;
    }
};

} // namespace pallax::doubles
