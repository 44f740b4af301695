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

/// Section name to record. The class index owns the records.
using ClassDict = std::map<std::string, Base*, std::less<>>;
/// Log code to the records subscribed to it, in order of registration.
using CodeDict = std::map<LogCode, std::vector<Base*>>;

/// A record owns one named section of the display, subscribes to log codes, and turns each of
/// their log records into display values.
class Base {
public:
    Base() = default;
    virtual ~Base() = default;
    Base(const Base&) = delete;
    Base& operator=(const Base&) = delete;

    /// Registers under the section name and for every log code. The class index calls it once,
    /// after the constructor, which could not ask a subclass for them.
    void initWithDict(ClassDict& classDict, CodeDict& codeDict);

    /// Sets the section, a dictionary or an array that was built from the template.
    virtual void updateSectionRef(PropertyList section);

    /// Reads one log record, header included, under its effective code.
    virtual void updateWithData(const LogRecord& record, LogCode logCode);
    /// The key of the section in the display template.
    virtual std::string_view getSectionName() const;
    /// The effective codes that the record subscribes to, in order.
    virtual std::span<const LogCode> getLogCodeArray() const;
    /// Appends this record to the subscribers of each of its codes.
    void updateLogCodeDict(CodeDict& codeDict);

    /// Removes all elements, under the array lock.
    static void clearElementsInArray(Array& array);
    /// Replaces all elements with those of `with`, in one step under the array lock.
    static void replaceArray(Array& array, Array with);

    /// A linear Ec/No value in whole dB, where 2^19 is 0 dB. Values too small to measure (705 and
    /// below) and values at or above full scale give 0.
    static std::int16_t lookUpECNO(std::uint32_t value);

protected:
    const PropertyList& sectionRef() const { return _sectionRef; }

private:
    PropertyList _sectionRef; // shared with the live display
};

} // namespace pallax
