#include "cli/ServiceRequest.h"

#include "cli/ModemOptions.h"
#include "cli/OptionParts.h"
#include "cli/SimulateOptions.h"

namespace pallax {

namespace {

constexpr const char* kServiceFooter = R"(Examples:
  pallax service --play drive.pcap
  pallax service --play drive.pcap --speed max --loop
  pallax service --simulate lte --seed 7
  pallax service --simulate ifx --seconds 600 --speed max
  ssh phone modem-dump | pallax service --relay -
  pallax service --name car1 --simulate lte
  pallax service --modem
  pallax service --status
  pallax service --list

Each client gets its own channel. A recording or simulation restarts for each
client; a named pipe is played once, to the first. A relayed stream goes live to
all clients, after a wait for the first one (--wait), and the service ends with
it. A modem of this machine (--modem, see pallax modem --help) is live, too; the
service stays while it is unplugged.
A slow client loses packets but delays no other client; with --speed max it sets
its own pace and loses nothing.

Services with names (--name) run beside each other; pallax --connect NAME shows
the modem of one, and commands about the live modem take --connect, too. The one
service without a name is what they use otherwise; --list does not list it.

Exit status:
  0   success: ended by Ctrl-C, or at the regular end of the relayed stream
  1   failure, explained in one sentence on standard error
  2   wrong usage)";

void addServicePlay(CLI::App& app, ServiceOptions& options) {
    CLI::Option* recording =
        app.add_option_function<std::string>(
               "--play",
               [&options](const std::string& path) { options.source = recordingAt(path); },
               "The recording to play to each client")
            ->type_name("RECORDING");
    addSpeed(app, options.play);
    app.add_flag("--loop", options.play.loop, "Restart at the end of the recording")
        ->needs(recording);
}

void addServiceRelay(CLI::App& app, ServiceOptions& options) {
    const auto take = [&options](const std::string& text) {
        if (text != "-") {
            throw CLI::ValidationError("--relay", "only -, standard input, can be relayed");
        }
        options.source = recordingAt(text);
        options.relay = true;
    };
    app.add_option_function<std::string>(
           "--relay", take, "Relay the live pcap stream on standard input (-) to every client")
        ->type_name("-")
        ->excludes("--play")
        ->excludes("--speed") // the stream sets the pace
        ->excludes("--simulate");
    constexpr double kLongest = 1e6; // eleven days
    static constexpr const char* kRefusal = "must be a number from 0 to 1000000";
    const auto takePatience = [&options](const double& seconds) {
        if (!(seconds >= 0 && seconds <= kLongest)) {
            throw CLI::ValidationError("--wait", kRefusal);
        }
        options.relayPatience = std::chrono::duration_cast<std::chrono::nanoseconds>(
            std::chrono::duration<double>(seconds));
    };
    app.add_option_function<double>(
           "--wait", takePatience,
           "How long a relayed stream waits for its first client (default: 10)")
        ->type_name("SECONDS")
        // The library reads an empty text as 0.
        ->check([](const std::string& text) { return text.empty() ? kRefusal : ""; })
        ->needs("--relay");
}

void addServiceModem(CLI::App& app, ServiceOptions& options) {
    const auto modem = [&options]() -> LocalModem& {
        auto* local = std::get_if<LocalModem>(&options.source);
        return local != nullptr ? *local : options.source.emplace<LocalModem>();
    };
    addModemSource(app, modem,
                   "Serve a modem of this machine, by default the first one that is enabled")
        ->excludes("--play")
        ->excludes("--speed") // the modem sets the pace
        ->excludes("--simulate")
        ->excludes("--relay");
}

/// A flag that prints something instead of running the service.
CLI::Option* addPrinting(CLI::App& app, const char* name, bool& flag, const char* description) {
    return app.add_flag(name, flag, description)
        ->excludes("--play")
        ->excludes("--speed")
        ->excludes("--simulate")
        ->excludes("--relay")
        ->excludes("--modem");
}

void addServiceName(CLI::App& app, std::string& name) {
    app.add_option_function<std::string>(
           "--name", [&name](const std::string& text) { name = serviceNameOf("--name", text); },
           "The service's name, to which --connect refers; several services can run if at most one "
           "has no name")
        ->type_name("NAME");
}

} // namespace

void addService(CLI::App& app, ServiceRequest& request) {
    addServicePlay(app, request.options);
    addServiceSimulation(app, request.options.source)->excludes("--play");
    addServiceRelay(app, request.options);
    addServiceModem(app, request.options);
    addServiceName(app, request.options.name);
    addPrinting(app, "--status", request.status,
                "Print the status of the running service and exit");
    addPrinting(app, "--list", request.list, "List the names of running services and exit")
        ->excludes("--name")
        ->excludes("--status");
    app.footer(kServiceFooter);
}

ParsedOptions serviceOptions(const ServiceRequest& request) {
    if (request.status) {
        return ServiceStatusOptions{request.options.name};
    }
    if (request.list) {
        return ServiceListOptions();
    }
    const Source& source = request.options.source;
    if (std::holds_alternative<ServiceModem>(source) || recordingPath(source) == "") {
        return wrongUsage(
            "the service needs --play, --simulate, --relay, --modem, --status or --list",
            "service");
    }
    return request.options;
}

} // namespace pallax
