#pragma once

#include "LogGenerator/SectionAges.h"
#include "plist/PropertyList.h"
#include "text/Bytes.h"

#include <memory>
#include <span>
#include <string_view>

namespace pallax {

struct KeyFrame;
class Bundle;
class Clock;
class LogGenerator;
class Resources;
class SampleSink;
class StandardOutput;

/// The services that a generator uses. They must outlive it.
struct GeneratorEnvironment {
    const Clock& clock;             ///< history dates, the DLF's time stamp
    const Resources& resources;     ///< display templates
    const Bundle& bundle;           ///< the DLF's application text and build date
    StandardOutput& standardOutput; ///< destruction notices
};

/// One row of the technology table: an identifier of the modem and the generator for it.
struct Technology {
    std::string_view identifier;
    std::unique_ptr<LogGenerator> (*generator)(const GeneratorEnvironment& environment);
};

/// The abstract base of the generators, one for each technology. A generator turns log packets
/// into a display dictionary and a save record, and keeps them in a state that the model owns.
///
/// The state's keys: "Template" (the display template as loaded), "Display" (the live display, up
/// to date after `display`), "ExtraInfo", "DisplayState" (data: everything received since the
/// previous display generation, or the latest object of an object stream) and "History" (array of
/// at most 5 entries, oldest first).
class LogGenerator {
public:
    static constexpr std::size_t kHistoryLength = 5;

    explicit LogGenerator(const GeneratorEnvironment& environment);
    virtual ~LogGenerator() = default;
    LogGenerator(const LogGenerator&) = delete;
    LogGenerator& operator=(const LogGenerator&) = delete;

    /// Abstract operations throw UnrecognisedOperation unless overridden.

    /// Reads one message from the log channel; an empty one counts as null. Exceptions of records
    /// pass through, and the packet is then not captured.
    virtual void updateState(Dictionary& state, Bytes data);
    /// The display dictionary, or null when there is none yet. Rotates history and raw capture.
    virtual PropertyList generateLogUsingState(Dictionary& state);
    /// The live display, up to date with the latest packet, or null when there is none yet. The
    /// history's entries share its sections and are therefore also brought up to date.
    PropertyList display(const Dictionary& state);
    /// Also gives the samples of later packets to `sink`; null stops it. The caller begins and ends
    /// the packets. The sink must outlive the generator or be removed first.
    virtual void setSampleSink(SampleSink* /*sink*/) {}
    /// The times at which the values of the display, brought up to date, were last read.
    SectionAges sectionAges(const Dictionary& state);
    /// What later packets build on; `state` as for `display`.
    KeyFrame keyFrame(const Dictionary& state);
    /// Goes on from a key frame of the same technology. For a new generator and an empty state.
    /// Until the next packet, the display is the key frame's.
    virtual void resume(Dictionary& /*state*/, const KeyFrame& /*from*/) {}
    /// True when this generator cannot update the display that an earlier one left in the state.
    virtual bool keepsDisplay(const Dictionary& state) const;
    /// The property-list dictionary that starts the modem's stream.
    virtual PropertyList getStartCommand() const;
    /// The content of a snapshot file: an array of the history entries and any further ones.
    virtual PropertyList getSaveContentsFromState(const Dictionary& state) const;

    /// Appends the current display to the state's history, which keeps the newest 5 entries. An
    /// entry is a dictionary of "DisplayState", "Display", "ExtraInfo" (one-level copies), "Date"
    /// and "Description", in this order; it ends before the first missing value.
    static void updateHistoryInState(Dictionary& state, const Clock& clock);

    /// A new generator of the first technology in `technologies` whose identifier equals
    /// `technology`, or null.
    static std::unique_ptr<LogGenerator>
    generatorFromTechnology(const PropertyList& technology,
                            std::span<const Technology> technologies,
                            const GeneratorEnvironment& environment);

protected:
    /// Brings the live display in the state up to date with the latest packet, for generators that
    /// read packets late.
    virtual void bringDisplayUpToDate() {}
    /// The ages in the state's live display, which is up to date. Empty unless overridden.
    virtual SectionAges agesIn(const Dictionary& state) const;

    /// Adds this generator's part of a key frame; the display is up to date.
    virtual void addTo(KeyFrame& /*keyFrame*/, const Dictionary& /*state*/) const {}

    /// Selects the constructors of a generator without parts, which log and build nothing.
    struct WithoutParts {};
    static constexpr WithoutParts kWithoutParts{};
    LogGenerator(const GeneratorEnvironment& environment, WithoutParts /*unused*/)
        : _environment(environment) {}

    const GeneratorEnvironment& environment() const { return _environment; }
    /// A copy of the state's history; empty if there is none.
    static Array historyOf(const Dictionary& state);

private:
    GeneratorEnvironment _environment;
};

} // namespace pallax
