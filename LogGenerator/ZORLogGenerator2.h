#pragma once

#include "LogGenerator/Records/ClassIndex.h"
#include "LogGenerator/ZORLogGenerator.h"

#include <memory>
#include <string>

namespace pallax {

/// The template-driven generator: builds the display from a template resource, hands each
/// section to the record that owns it, dispatches every log record to the records subscribed to
/// its code, and asks the modem for exactly those codes.
///
/// A template is a property list of dictionaries, arrays and strings; a dictionary key that
/// equals a record's section name makes its value that record's section, at any depth.
///
/// A technology that has no template to offer makes a generator without parts, on which every call
/// does nothing and returns nothing.
class ZORLogGenerator2 : public ZORLogGenerator {
public:
    ~ZORLogGenerator2() override;

    void updateState(Dictionary& state, Bytes data) override;
    PropertyList generateLogUsingState(Dictionary& state) override;
    void setSampleSink(SampleSink* sink) override;
    PropertyList getStartCommand() const override;

    /// Framing and dispatch of one packet.
    void updateWithData(Bytes data);
    /// The live display made from a template object; null for anything but dictionary, array and
    /// string. Records get their sections on the way.
    PropertyList processTemplate(const PropertyList& object);
    /// Logs what a display must not hold; changes nothing.
    static void printDict(const PropertyList& object);
    /// The display. The call that builds it returns null, and only later calls return it.
    PropertyList getDisplayFromState(Dictionary& state);

protected:
    void bringDisplayUpToDate() override;
    SectionAges agesIn(const Dictionary& state) const override;

    /// What a technology supplies: the template's resource name and a new class index.
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
