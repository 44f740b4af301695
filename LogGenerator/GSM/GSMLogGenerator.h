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

/// The generator of the IFX modem, whose log channel carries serialized objects. Each message is a
/// property list, in any form, of dictionaries, arrays and strings, and contains the whole picture.
/// The display is that object, simplified; earlier messages leave nothing in it.
class GSMLogGenerator final : public LogGenerator {
public:
    /// A message is not in the expected form. It does not change the state. The core does not catch
    /// this.
    class InternalInconsistencyException : public std::runtime_error {
    public:
        static constexpr const char* kFile = "LogGenerator/GSM/GSMLogGenerator";

        /// `line` identifies the failure; it is not a line of this source.
        InternalInconsistencyException(const std::string& message, int line);

        /// "Could not deserialize the object"; what() also has the location.
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

    /// Throws InternalInconsistencyException for a message that is not a property list or is empty,
    /// and for values of other types anywhere in it.
    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override;
    void setSampleSink(SampleSink* sink) override { _sink = sink; }
    void resume(Dictionary& state, const KeyFrame& from) override;
    /// Always false: every message is the whole display.
    bool keepsDisplay(const Dictionary& /*state*/) const override { return false; }
    PropertyList getStartCommand() const override;
    PropertyList getSaveContentsFromState(const Dictionary& state) const override;

    /// The display form, in new containers: below the top, each dictionary of one entry is replaced
    /// by that entry's value, so that chains of them collapse completely. The first element of each
    /// array is left out, but also checked: throws InternalInconsistencyException for values of
    /// other types.
    static PropertyList processObject(const PropertyList& object);

    /// The value of a dictionary with exactly one entry; null for all others.
    static PropertyList canCollapse(const PropertyList& object);

protected:
    void bringDisplayUpToDate() override;
    SectionAges agesIn(const Dictionary& state) const override;
    void addTo(KeyFrame& keyFrame, const Dictionary& state) const override;

private:
    /// Makes a checked object the latest message.
    void take(Dictionary& state, const PropertyList& object);
    /// The display of an object whose types were checked. A dictionary stays empty until
    /// `bringDisplayUpToDate`, because usually the next message comes before the display is needed.
    PropertyList displayToCome(const PropertyList& object);

    DictionaryRef _unshown;    // the object whose display is not made yet, or null
    DictionaryRef _display;    // its display in the state, empty until then
    std::optional<Time> _read; // when the latest message came
    SampleSink* _sink = nullptr;
    ObjectSamples _samples;
};

} // namespace pallax
