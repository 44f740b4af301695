#pragma once

#include "LogGenerator/Records/LogRecord.h"
#include "plist/PropertyList.h"

#include <exception>

namespace pallax {

/// The reader of the SIM-file record: behind the header of the extended record 0xFF0000 stands a
/// serialized property list, a dictionary of SIM files. (The name is older than the code.)
class LogCode_0xFF000020 {
public:
    /// Thrown when the property list embedded in the record cannot be parsed. Nothing in the core
    /// catches it.
    class UnknownDataException : public std::exception {
    public:
        const char* what() const noexcept override {
            return "the embedded property list cannot be parsed";
        }
    };

    /// Throws UnknownDataException, with "SIM File dictionary data could not be constructed" in
    /// the log, when the payload is no property list.
    explicit LogCode_0xFF000020(const LogRecord& record);

    /// What the service sent: a dictionary, unless the payload is another property list.
    const PropertyList& files() const { return _files; }

private:
    PropertyList _files;
};

} // namespace pallax
