#pragma once

#include "LogGenerator/ZORLogGenerator.h"

#include <memory>
#include <span>

namespace pallax {

struct CodeLayout;
class LookupDisplay;

/// The generator of the CDMA technology, 1x and EV-DO. It has no records with sections of their
/// own: the layout of a log code tells which value stands under which lookup name, and the
/// template "C2KTemplate" says where that name is shown, in as many places as it likes.
///
/// A template is a property list of dictionaries. In any of them a dictionary is a section, the
/// string "_sorted" stands for itself, any other string is a lookup name, and the rest is ignored.
///
/// The state's keys, beside those of every generator: "Lookup" (the lookup table, see C2KLookup.h)
/// and the running values of the layouts.
class C2KLogGenerator final : public ZORLogGenerator {
public:
    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment);

    explicit C2KLogGenerator(const GeneratorEnvironment& environment);
    ~C2KLogGenerator() override;

    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override;
    void setSampleSink(SampleSink* sink) override;
    /// Not where the state also holds the places of its values, which an earlier one has left.
    bool keepsDisplay(const Dictionary& state) const override;
    PropertyList getStartCommand() const override;

    /// Adds a template's rows to a display and their places to a lookup table.
    static void processTemplate(const Dictionary& templateDictionary,
                                const DictionaryRef& storeDisplayIntoDict,
                                Dictionary& storeLookupIntoDict);
    /// The display, made on first use; null while the template cannot be loaded.
    PropertyList getDisplayFromState(Dictionary& state) const;
    /// Framing and dispatch of one packet. A packet of a known code is captured behind its prefix,
    /// whether or not its layout accepts it; nothing else is captured. A wrong log type is
    /// reported, but does not stop the packet.
    void updateFromLog(Bytes packet, const DictionaryRef& lookup, Dictionary& state);

    /// The layouts in the order of the start command, in which their rows of fields are numbered.
    static std::span<const CodeLayout* const> layouts();

protected:
    void bringDisplayUpToDate() override;
    SectionAges agesIn(const Dictionary& state) const override;

private:
    std::unique_ptr<LookupDisplay> _display;
};

} // namespace pallax
