#pragma once

#include "LogGenerator/SectionAges.h"
#include "plist/PropertyList.h"
#include "text/Bytes.h"

#include <memory>
#include <span>
#include <string_view>

namespace pallax {

class Bundle;
class Clock;
class LogGenerator;
class Resources;
class SampleSink;
class StandardOutput;

/// What a generator needs of its surroundings. All of it outlives the generator.
struct GeneratorEnvironment {
    const Clock& clock;             ///< history dates, the DLF's time stamp
    const Resources& resources;     ///< display templates
    const Bundle& bundle;           ///< the DLF's application text and build date
    StandardOutput& standardOutput; ///< destruction notices
};

/// One row of the technology table: what the modem answers, and who speaks it.
struct Technology {
    std::string_view identifier;
    std::unique_ptr<LogGenerator> (*generator)(const GeneratorEnvironment& environment);
};

/// The abstract base of every per-technology generator: turns log packets into a display
/// dictionary and a save record, always working on the state dictionary that the model owns.
///
/// The state's keys: "Template" (the display template as loaded), "Display" (the live display, up
/// to date after `display`), "ExtraInfo", "DisplayState" (data: what was received since the
/// previous display generation; of an object stream the latest object) and "History" (array of at
/// most 5 entries, oldest first).
class LogGenerator {
public:
    static constexpr std::size_t kHistoryLength = 5;

    explicit LogGenerator(const GeneratorEnvironment& environment);
    virtual ~LogGenerator() = default;
    LogGenerator(const LogGenerator&) = delete;
    LogGenerator& operator=(const LogGenerator&) = delete;

    /// Abstract operations throw UnrecognisedOperation unless overridden.

    /// One message from the log channel; an empty one counts as null. A record that throws lets
    /// its exception leave, and the packet is then not captured.
    virtual void updateState(Dictionary& state, Bytes data);
    /// The display dictionary, or null when there is none yet. Rotates history and raw capture.
    virtual PropertyList generateLogUsingState(Dictionary& state);
    /// The live display, with every packet that has arrived, or null when there is none yet. Its
    /// sections are those of the history's entries, which are up to date afterwards too.
    PropertyList display(const Dictionary& state);
    /// Gives the samples of later packets to `sink`, too, until it is null. The caller begins and
    /// ends the packets. The sink outlives the generator, or is taken away.
    virtual void setSampleSink(SampleSink* /*sink*/) {}
    /// When the values of the display, with every packet that has arrived, were last read.
    SectionAges sectionAges(const Dictionary& state);
    /// True when this generator cannot update the display that an earlier one left in the state.
    virtual bool keepsDisplay(const Dictionary& state) const;
    /// The property-list dictionary that starts the modem's stream.
    virtual PropertyList getStartCommand() const;
    /// History entries and what else a snapshot file carries: an array.
    virtual PropertyList getSaveContentsFromState(const Dictionary& state) const;

    /// Appends the current display to the state's history, of which the newest 5 stay. An entry
    /// is a dictionary of "DisplayState", "Display", "ExtraInfo" (one-level copies), "Date" and
    /// "Description"; a missing value ends it there.
    static void updateHistoryInState(Dictionary& state, const Clock& clock);

    /// A new generator of the first technology in `technologies` whose identifier equals
    /// `technology`, or null.
    static std::unique_ptr<LogGenerator>
    generatorFromTechnology(const PropertyList& technology,
                            std::span<const Technology> technologies,
                            const GeneratorEnvironment& environment);

protected:
    /// Brings the live display in the state up to the latest packet: a generator may read a packet
    /// as late as that.
    virtual void bringDisplayUpToDate() {}
    /// The ages in the live display of the state, which is up to date. Nothing is known of them
    /// unless it is overridden.
    virtual SectionAges agesIn(const Dictionary& state) const;

    /// Marks a generator whose parts are missing: its making is not logged, and what its class
    /// builds up is left out.
    struct WithoutParts {};
    static constexpr WithoutParts kWithoutParts{};
    LogGenerator(const GeneratorEnvironment& environment, WithoutParts /*unused*/)
        : _environment(environment) {}

    const GeneratorEnvironment& environment() const { return _environment; }
    /// The entries of the state's history, in an array of their own; none without one.
    static Array historyOf(const Dictionary& state);

private:
    GeneratorEnvironment _environment;
};

} // namespace pallax
