#include "telephony/ServiceStatus.h"

#include "host/SocketMessagePorts.h"
#include "telephony/ControlMessages.h"
#include "telephony/NamedServices.h"
#include "text/Format.h"
#include "text/Printable.h"

#include <chrono>

namespace pallax {

namespace {

constexpr const char* kRequest = "GetStatus";

std::optional<std::int64_t> countIn(const Dictionary& message, std::string_view key) {
    const PropertyList* value = message.find(key);
    return value != nullptr ? value->integer() : std::nullopt;
}

std::optional<ServiceStatus::Client> parseClient(const PropertyList& element) {
    const DictionaryRef entry = element.dictionary();
    if (entry == nullptr) {
        return std::nullopt;
    }
    const auto localPort = stringIn(*entry, "LocalPort");
    const PropertyList* streaming = entry->find("Streaming");
    const auto isStreaming = streaming != nullptr ? streaming->boolean() : std::nullopt;
    const auto sent = countIn(*entry, "Sent");
    const auto dropped = countIn(*entry, "Dropped");
    if (!localPort || !isStreaming || !sent || !dropped) {
        return std::nullopt;
    }
    return ServiceStatus::Client{*localPort, *isStreaming, *sent, *dropped};
}

} // namespace

Dictionary statusRequest() {
    return {{kRequest, kRequest}};
}

bool isStatusRequest(const Dictionary& message) {
    return stringIn(message, kRequest) == kRequest;
}

Dictionary statusReply(const ServiceStatus& status) {
    Array clients;
    for (const ServiceStatus::Client& client : status.clients) {
        clients.emplace_back(Dictionary{{"LocalPort", client.localPort},
                                        {"Streaming", PropertyList::boolean(client.isStreaming)},
                                        {"Sent", PropertyList::integer(client.sent)},
                                        {"Dropped", PropertyList::integer(client.dropped)}});
    }
    return {{"Technology", status.technology},
            {"Uptime", PropertyList::integer(status.uptimeSeconds)},
            {"Sent", PropertyList::integer(status.sent)},
            {"Dropped", PropertyList::integer(status.dropped)},
            {"Clients", std::move(clients)}};
}

std::optional<ServiceStatus> parseStatusReply(const Dictionary& reply) {
    const auto technology = stringIn(reply, "Technology");
    const auto uptime = countIn(reply, "Uptime");
    const auto sent = countIn(reply, "Sent");
    const auto dropped = countIn(reply, "Dropped");
    const PropertyList* list = reply.find("Clients");
    const ArrayRef clients = list != nullptr ? list->array() : nullptr;
    if (!technology || !uptime || !sent || !dropped || clients == nullptr) {
        return std::nullopt;
    }
    ServiceStatus status{*technology, *uptime, *sent, *dropped, {}};
    for (const PropertyList& element : *clients) {
        auto client = parseClient(element);
        if (!client) {
            return std::nullopt;
        }
        status.clients.push_back(std::move(*client));
    }
    return status;
}

Result<ServiceStatus, HostError> askStatus(SocketMessagePorts& ports,
                                           const std::string& controlPortName) {
    constexpr std::chrono::milliseconds kSendTimeout{500};
    constexpr std::chrono::milliseconds kReplyTimeout{1200};
    constexpr const char* kSilent = "The telephony service does not answer.";
    const auto port = ports.createRemote(controlPortName);
    if (port == nullptr) {
        return HostError{ports.isTaken(controlPortName)
                             ? kSilent
                             : noServiceText(ports.directory().service()) + "."};
    }
    const auto request = encodeMessage(statusRequest());
    const auto outcome = port->sendRequest({0, *request, kSendTimeout, kReplyTimeout, true});
    if (outcome.error != SendError::None) {
        return HostError{kSilent};
    }
    const auto message = outcome.reply ? decodeMessage(*outcome.reply) : std::nullopt;
    const auto status = message ? parseStatusReply(*message) : std::nullopt;
    if (!status) {
        return HostError{"The telephony service does not report its status."};
    }
    return *status;
}

std::string statusText(const ServiceStatus& status) {
    std::string technology; // as sent by the service
    appendPrintable(technology, status.technology);
    std::string text = formatText(
        "Technology: %@\nUptime: %lld s\nPackets sent: %lld\n"
        "Packets dropped: %lld\nClients: %zu\n",
        {technology, status.uptimeSeconds, status.sent, status.dropped, status.clients.size()});
    for (const ServiceStatus::Client& client : status.clients) {
        const char* state = client.isStreaming ? "streaming"
                            : client.sent > 0  ? "at the end"
                                               : "not started";
        std::string name; // chosen by the client, and shown on a terminal
        appendPrintable(name, client.localPort);
        text += formatText("  %@: %@, %lld packets sent, %lld dropped\n",
                           {name, state, client.sent, client.dropped});
    }
    return text;
}

} // namespace pallax
