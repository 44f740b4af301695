#pragma once

#include "LogGenerator/ZORLogGenerator.h"

#include <memory>
#include <span>

namespace pallax {

struct CodeLayout;
class LookupDisplay;

/// The generator of the CDMA technology, 1x and EV-DO. Instead of records with sections it has
/// layouts that give each value a lookup name; the template "C2KTemplate" shows each name in any
/// number of places.
///
/// A template is a property list of dictionaries. In each, a dictionary is a section, the string
/// "_sorted" is copied, other strings are lookup names, and other types are ignored.
///
/// Additional keys of the state: "Lookup" (the lookup table, see C2KLookup.h) and the running
/// values of the layouts.
class C2KLogGenerator final : public ZORLogGenerator {
public:
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment);

    explicit C2KLogGenerator(const GeneratorEnvironment& environment);
    ~C2KLogGenerator() override;

    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override;
    void setSampleSink(SampleSink* sink) override;
    void resume(Dictionary& state, const KeyFrame& from) override;
    /// False if the state has a lookup table from an earlier generator.
    bool keepsDisplay(const Dictionary& state) const override;
    PropertyList getStartCommand() const override;

    /// Adds a template's rows to a display, and their places to a lookup table.
    static void processTemplate(const Dictionary& templateDictionary,
                                const DictionaryRef& storeDisplayIntoDict,
                                Dictionary& storeLookupIntoDict);
    /// The display, made at the first call; null if the template cannot be loaded.
    PropertyList getDisplayFromState(Dictionary& state) const;
    /// Checks the framing of one packet and dispatches it. Packets of known codes are captured,
    /// without the prefix, even if their layout refuses them; others are not. A wrong log type is
    /// reported, but does not stop the packet.
    void updateFromLog(Bytes packet, const DictionaryRef& lookup, Dictionary& state);

    /// The layouts in the order of the start command, in which their rows are numbered.
    static std::span<const CodeLayout* const> layouts();

protected:
    void bringDisplayUpToDate() override;
    SectionAges agesIn(const Dictionary& state) const override;
    void addTo(KeyFrame& keyFrame, const Dictionary& state) const override;

private:
    std::unique_ptr<LookupDisplay> _display;
};

} // namespace pallax
