#pragma once

#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

#include <exception>

namespace pallax {

/// Reads the SIM-file record: the payload of the extended record 0xFF0000 is a serialized property
/// list, a dictionary of SIM files. (The class name is older than the log code.)
class LogCode_0xFF000020 {
public:
    /// Thrown when the property list in the record cannot be parsed. The core does not catch it.
    class UnknownDataException : public std::exception {
    public:
        const char* what() const noexcept override {
            return "the embedded property list cannot be parsed";
        }
    };

    /// Logs "SIM File dictionary data could not be constructed" and throws UnknownDataException
    /// when the payload is not a property list.
    explicit LogCode_0xFF000020(const LogRecord& record);

    /// The property list that the service sent, normally a dictionary.
    const PropertyList& files() const { return _files; }

private:
    PropertyList _files;
};

} // namespace pallax
