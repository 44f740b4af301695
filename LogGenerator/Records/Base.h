#pragma once

#include "LogGenerator/Records/LogCode.h"
#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

#include <cstdint>
#include <map>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace pallax {

class Base;

/// Section name to record. The records are owned by the class index.
using ClassDict = std::map<std::string, Base*, std::less<>>;
/// Log code to the records subscribed to it, in order of registration.
using CodeDict = std::map<LogCode, std::vector<Base*>>;

/// A record: owns one named section of the display, subscribes to log codes, and turns each log
/// record that arrives under one of them into display values.
class Base {
public:
    Base() = default;
    virtual ~Base() = default;
    Base(const Base&) = delete;
    Base& operator=(const Base&) = delete;

    /// Registers under the section name and for every log code. The class index calls it once,
    /// after the constructor (which could not ask a subclass for either).
    void initWithDict(ClassDict& classDict, CodeDict& codeDict);

    /// The section that the template processing has built: a dictionary or an array.
    virtual void updateSectionRef(PropertyList section);

    /// One log record, header included, under its effective code.
    virtual void updateWithData(const LogRecord& record, LogCode logCode);
    /// The key of the section in the display template.
    virtual std::string_view getSectionName() const;
    /// The effective codes that the record wants, in order.
    virtual std::span<const LogCode> getLogCodeArray() const;
    /// Appends this record to the subscribers of each of its codes.
    void updateLogCodeDict(CodeDict& codeDict);

    /// Removes all elements, under the array lock.
    static void clearElementsInArray(Array& array);
    /// Replaces all elements by those of `with`, in one step under the array lock.
    static void replaceArray(Array& array, Array with);

    /// Whole dB of a linear Ec/No value, scaled so that 2^19 is 0 dB. Values too small to measure
    /// (705 and below) give 0, as do those at or above full scale.
    static std::int16_t lookUpECNO(std::uint32_t value);

protected:
    const PropertyList& sectionRef() const { return _sectionRef; }

private:
    PropertyList _sectionRef; // shared with the live display, which owns it
};

} // namespace pallax
