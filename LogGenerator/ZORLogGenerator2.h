#pragma once

#include "LogGenerator/Records/ClassIndex.h"
#include "LogGenerator/ZORLogGenerator.h"

#include <memory>
#include <string>

namespace pallax {

/// The template-driven generator. It builds the display from a template resource, gives each
/// section to the record that owns it, dispatches each log record to the records subscribed to
/// its code, and requests exactly those codes from the modem.
///
/// A template is a property list of dictionaries, arrays and strings. If a dictionary key, at any
/// depth, equals a record's section name, its value becomes that record's section.
///
/// A technology without a template makes a generator without parts, whose calls do nothing and
/// return nothing.
class ZORLogGenerator2 : public ZORLogGenerator {
public:
    ~ZORLogGenerator2() override;

    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override;
    void setSampleSink(SampleSink* sink) override;
    void resume(Dictionary& state, const KeyFrame& from) override;
    PropertyList getStartCommand() const override;

    /// Checks the framing of one packet and dispatches it.
    void updateWithData(Bytes data);
    /// Makes the live display from a template object and gives records their sections. Null for
    /// types other than dictionary, array and string.
    PropertyList processTemplate(const PropertyList& object);
    /// Logs values that a display must not contain.
    static void printDict(const PropertyList& object);
    /// The display. The first call builds it and returns null; later calls return it.
    PropertyList getDisplayFromState(Dictionary& state);

protected:
    void bringDisplayUpToDate() override;
    SectionAges agesIn(const Dictionary& state) const override;
    void addTo(KeyFrame& keyFrame, const Dictionary& state) const override;

    /// The parts of a technology: the template's resource name and a new class index.
    struct Parts {
        std::string pListName;
        std::shared_ptr<ClassIndex> cIndex;
    };
    ZORLogGenerator2(const GeneratorEnvironment& environment, Parts parts);
    ZORLogGenerator2(const GeneratorEnvironment& environment, WithoutParts without)
        : ZORLogGenerator(environment, without) {}

private:
    PropertyList loadTemplate(Dictionary& state) const;

    std::string pListName;
    std::shared_ptr<ClassIndex> cIndex; // null without parts
};

} // namespace pallax
