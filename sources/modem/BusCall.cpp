#include "sources/modem/BusCall.h"

namespace pallax {

bool BusError::isDenied() const {
    return name == "org.freedesktop.DBus.Error.AccessDenied" ||
           name == "org.freedesktop.ModemManager1.Error.Core.Unauthorized";
}

bool BusError::isUnsupported() const {
    return name == "org.freedesktop.ModemManager1.Error.Core.Unsupported" ||
           name == "org.freedesktop.DBus.Error.UnknownMethod" ||
           name == "org.freedesktop.DBus.Error.NotSupported";
}

bool BusError::isUnanswered() const {
    return name == "org.freedesktop.DBus.Error.NoReply" ||
           name == "org.freedesktop.DBus.Error.Timeout";
}

} // namespace pallax
