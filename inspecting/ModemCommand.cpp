#include "inspecting/ModemCommand.h"

#include "console/Output.h"
#include "host/AsioMainQueue.h"
#include "host/Complaint.h"
#include "sources/modem/ModemBus.h"
#include "sources/modem/ModemList.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemObjects.h"
#include "text/Format.h"

#include <chrono>
#include <string>
#include <unistd.h>

namespace pallax {

namespace {

constexpr std::chrono::milliseconds kObjectsPatience{5000};
constexpr std::chrono::milliseconds kCellsPatience{2000};

std::string whyNoObjects(const BusError& error) {
    if (error.isDenied()) {
        return "This user may not ask ModemManager: the system bus rejects it.";
    }
    return error.isUnanswered() ? "ModemManager does not answer." : "ModemManager is not running.";
}

} // namespace

ExitStatus runModemList(const ModemListOptions& /*options*/) {
    AsioMainQueue queue;
    auto bus = ModemBus::open(queue);
    if (!bus) {
        complain(bus.error().sentence);
        return kExitFailure;
    }
    BusCall question = ModemBus::managedObjects();
    question.patience = kObjectsPatience;
    const BusReply reply = (*bus)->callNow(question);
    if (!reply) {
        complain(whyNoObjects(reply.error()));
        return kExitFailure;
    }
    ModemObjects objects;
    objects.replace(*reply);
    if (objects.modems().empty()) {
        complain("ModemManager has no modem.");
        return kExitFailure;
    }
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    output.text() += modemList(objects, [&bus](const std::string& path) {
        BusCall call{path, modem_names::kModem, "GetCellInfo"};
        call.patience = kCellsPatience;
        return (*bus)->callNow(call);
    });
    output.flush();
    return kExitSuccess;
}

ExitStatus runModemPolicy(const ModemPolicyOptions& /*options*/) {
    Output output(writeToDescriptor(STDOUT_FILENO, "Standard output"));
    output.text() += cellPolicy();
    output.flush();
    return kExitSuccess;
}

} // namespace pallax
