#pragma once

#include "LogGenerator/GSM/ObjectSamples.h"
#include "LogGenerator/LogGenerator.h"
#include "text/Text.h"

#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>

namespace pallax {

/// The generator of the IFX modem, whose log channel carries serialized objects: each message is
/// one property list, in any of the forms, of dictionaries, arrays and strings, and holds the
/// whole picture. The display is that object, simplified; nothing of an earlier message stays.
class GSMLogGenerator final : public LogGenerator {
public:
    /// A message breaks what this generator counts on. The state is then as it was before the
    /// message. Nothing in the core catches it.
    class InternalInconsistencyException : public std::runtime_error {
    public:
        static constexpr const char* kFile = "LogGenerator/GSM/GSMLogGenerator";

        /// `line` is the number by which a failure is known; it does not follow the source.
        InternalInconsistencyException(const std::string& message, int line);

        /// "Could not deserialize the object"; what() has the location behind it.
        std::string_view message() const { return _message.view(); }
        const char* file() const { return kFile; }
        int line() const { return _line; }

    private:
        Text _message; // copying an exception must not throw
        int _line;
    };

    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment);

    explicit GSMLogGenerator(const GeneratorEnvironment& environment) : LogGenerator(environment) {}
    ~GSMLogGenerator() override;

    /// Throws InternalInconsistencyException for what is no property list, an empty message
    /// included, and for a value of another type than the three anywhere in it.
    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override;
    void setSampleSink(SampleSink* sink) override { _sink = sink; }
    /// Every message is the whole display.
    bool keepsDisplay(const Dictionary& /*state*/) const override { return false; }
    PropertyList getStartCommand() const override;
    PropertyList getSaveContentsFromState(const Dictionary& state) const override;

    /// The display form: in new containers, at every level below the top, a dictionary of one
    /// entry gives way to that entry's value, so that chains of them fold completely. The first
    /// element of every array is left out, though it too must be of the three types. Throws
    /// InternalInconsistencyException for another one.
    static PropertyList processObject(const PropertyList& object);

    /// The single value of a dictionary that has exactly one entry; null for anything else.
    static PropertyList canCollapse(const PropertyList& object);

protected:
    void bringDisplayUpToDate() override;
    SectionAges agesIn(const Dictionary& state) const override;

private:
    /// The display of an object whose values are of the three types; that of a dictionary is empty
    /// until `bringDisplayUpToDate`, for mostly the next message comes before anybody looks.
    PropertyList displayToCome(const PropertyList& object);

    DictionaryRef _unshown;    // the object whose display is still to be made, or null
    DictionaryRef _display;    // that display, empty until then; it is in the state
    std::optional<Time> _read; // when the latest message came
    SampleSink* _sink = nullptr;
    ObjectSamples _samples;
};

} // namespace pallax
