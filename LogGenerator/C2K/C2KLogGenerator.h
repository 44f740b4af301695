#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/ZORLogGenerator.h"

#include <array>
#include <cstddef>
#include <memory>
#include <vector>

namespace pallax {

struct CodeDescription;

/// The generator of the CDMA technology, 1x and EV-DO. It has no records with sections of their
/// own: the parser of a log code stores each value under a lookup name, and the template
/// "C2KTemplate" says where that name is shown, in as many places as it likes.
///
/// A template is a property list of dictionaries. In any of them a dictionary is a section, the
/// string "_sorted" stands for itself, any other string is a lookup name, and the rest is ignored.
///
/// The state's keys, beside those of every generator: "Lookup" (the lookup table, see C2KLookup.h)
/// and the running values of the parsers.
class C2KLogGenerator final : public ZORLogGenerator {
public:
    /// As many as there are parsers.
    static constexpr std::size_t kLogCodeCount = 8;

    static std::unique_ptr<LogGenerator> generator(const GeneratorEnvironment& environment);

    using ZORLogGenerator::ZORLogGenerator;
    ~C2KLogGenerator() override;

    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override;
    void catchUp() override;
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
    /// whether or not its parser accepts it; nothing else is captured. A wrong log type is
    /// reported, but does not stop the packet.
    void updateFromLog(Bytes packet, const DictionaryRef& lookup, Dictionary& state);

    /// What the parsers read and show, out of the constants that they read with (Description.h).
    static std::vector<CodeDescription> describe();

private:
    /// The latest packet of a code whose every packet replaces what the one before has shown: it is
    /// parsed when somebody looks. Null lookup: none.
    struct Kept {
        DictionaryRef lookup;
        ByteBuffer packet;
    };
    std::array<Kept, kLogCodeCount> _kept; // in the order of the parsers
};

} // namespace pallax
