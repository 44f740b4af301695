#include "telephony/NamedServices.h"

#include "host/SocketDirectory.h"
#include "host/UnixSocket.h"
#include "telephony/ControlMessages.h"
#include "text/Format.h"

namespace pallax {

std::string noServiceText(std::string_view name) {
    return name.empty() ? "No telephony service is running"
                        : formatText("No telephony service named %@ is running", {name});
}

std::vector<std::string> runningServices() {
    std::vector<std::string> names = SocketDirectory::services();
    std::erase_if(names, [](const std::string& name) {
        const auto directory = SocketDirectory::open(name);
        if (!directory) {
            return true;
        }
        const auto path = directory->socketPath(kTelephonyControlPort);
        return !path || listenerAt(*path) != Listener::Living;
    });
    return names;
}

} // namespace pallax
