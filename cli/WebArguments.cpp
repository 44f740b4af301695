#include "cli/WebArguments.h"

#include "cli/OptionParts.h"
#include "cli/SimulateOptions.h"
#include "web/InternetAddress.h"

#include <CLI/CLI.hpp>

#include <limits>

namespace pallax {

namespace {

constexpr const char* kWebFooter = R"(Examples:
  pallax web                           the live modem
  pallax web drive.pcapng --speed max  a recording
  pallax web demo lte                  a simulated modem
  pallax web --connect car1 --open     the modem of a service, in the browser
  pallax web --port 8080 --metrics     also for a collector of metrics
  pallax web --store fleet.db --device car1

Prints a link and serves a page at it until Ctrl-C: what pallax report shows,
while it happens. The page says what the serving cell was and is, draws levels
and neighbours, lists events, and has the whole state at any time since then.
A recording is played at its own pace; --speed max shows all of it at once. A
recording with the name "demo" needs its folder (pallax web ./demo).

With --store, the page is that of pallax report --store, made once at the start,
from a file or from a server (clickhouse://HOST/DATABASE).

The link holds a secret, which is new at each start and without which nothing
is served. Only programs of this machine can connect. From another machine,
forward the port, which needs neither --listen nor a certificate:

  ssh -L 8080:127.0.0.1:8080 car pallax web --port 8080

--listen ADDRESS lets other machines connect; they still need the link. Without
--certificate and --key, anyone on the network can read what is sent.

What identifies a person, a device or a subscription is masked as it arrives,
unless --with-identities is given.

With --metrics, programs of this machine get /metrics without the secret:
levels with their grades, states, the serving cell and counts, for Prometheus
and other collectors of OpenMetrics. They tell where the phone is, but not
whose it is, even with --with-identities.

Exit status:
  0   success: ended by Ctrl-C, or the reader of the output has gone
  1   failure, explained in one sentence on standard error
  2   wrong usage)";

/// "demo" as the first word is a command of this one, because CLI11 would take it for that of the
/// program.
CLI::App& addDemo(CLI::App& app, WebOptions& options) {
    CLI::App& demo = *app.add_subcommand("demo", "A simulated modem");
    demo.group("")->fallthrough();
    const auto take = [&options](const std::string& name) {
        options.source.emplace<SimulationOptions>().technology =
            simulatedTechnologyNamed("TECHNOLOGY", name);
    };
    demo.preparse_callback([&options](std::size_t /*words*/) {
        options.source.emplace<SimulationOptions>().technology = usualSimulatedTechnology();
    });
    demo.add_option_function<std::string>("TECHNOLOGY", take,
                                          "Technology of the simulated modem (default: lte)")
        ->type_name("");
    return demo;
}

void addListening(CLI::App& app, WebOptions& options) {
    app.add_option_function<std::string>(
           "--port",
           [&options](const std::string& text) {
               options.port = numberOf<std::uint16_t>("--port", text, 1,
                                                      std::numeric_limits<std::uint16_t>::max());
           },
           "Listen on this port (default: one that is free)")
        ->type_name("N");
    app.add_option_function<std::string>(
           "--listen",
           [&options](const std::string& text) {
               if (!InternetAddress::parse(text, 0)) {
                   throw CLI::ValidationError(
                       "--listen", '"' + text + "\" is no address of the form 127.0.0.1 or ::1");
               }
               options.address = text;
           },
           "Listen on this address of the machine, for other machines (default: 127.0.0.1)")
        ->type_name("ADDRESS");
    CLI::Option* certificate =
        app.add_option("--certificate", options.certificate, "Encrypt with this certificate (PEM)")
            ->type_name("FILE");
    app.add_option("--key", options.key, "The certificate's key (PEM)")
        ->needs(certificate)
        ->type_name("FILE");
    certificate->needs("--key");
    app.add_flag("--metrics", options.metrics,
                 "Serve /metrics to programs of this machine, without the link's secret");
}

/// --store, and what says which part of it is shown.
CLI::Option* addStoreOf(CLI::App& app, WebOptions& options) {
    CLI::Option* store =
        app.add_option("--store", options.store, "Show what this store holds of a device instead")
            ->type_name("FILE");
    app.add_option("--device", options.device, "The device of the store (default: the only one)")
        ->type_name("NAME")
        ->needs(store);
    addTechnology(app, "--technology", options.technology,
                  "The technology of the device's recordings (default: the only one)");
    app.get_option("--technology")->needs(store);
    addTime(app, "--from", options.from, "Begin at this time of the store")->needs(store);
    addTime(app, "--to", options.to, "End at this time of the store")->needs(store);
    return store;
}

} // namespace

void addWeb(CLI::App& app, WebOptions& options) {
    CLI::Option* source =
        app.add_option_function<std::vector<std::string>>(
               "RECORDING",
               [&options](const std::vector<std::string>& words) {
                   options.source = recordingToBrowse(words);
               },
               "The recording (pcap or pcapng; - is standard input) or its numbered parts, or "
               "demo [TECHNOLOGY] for a simulated modem (default: the live modem)")
            ->type_name("");
    CLI::Option* connect = app.add_option_function<std::string>(
        "--connect",
        [&options](const std::string& name) {
            options.source = ServiceModem{serviceNameOf("--connect", name)};
        },
        "The live modem of the service that has this name");
    connect->excludes(source)->type_name("NAME");
    CLI::Option* store = addStoreOf(app, options);
    addListening(app, options);
    app.add_flag("--open", options.open, "Open the page in the browser (xdg-open)");
    app.add_option("--profile", options.profile,
                   "The profile that judges levels (default: android, or that of pallax.conf)")
        ->type_name("android|field|operator|NAME");
    CLI::Option* identities = app.add_flag("--with-identities", options.withIdentities,
                                           "Do not mask what identifies a person");
    CLI::Option* speed = addSpeed(app, options.play);
    CLI::App& demo = addDemo(app, options);
    CLI::Option* metrics = app.get_option("--metrics");
    for (CLI::Option* option : {source, connect, speed, identities, metrics}) {
        store->excludes(option);
    }
    app.callback([&demo, source, connect, speed, store] {
        if (demo.parsed() && !store->empty()) {
            throw CLI::ValidationError("demo", "it is shown alone, without a store");
        }
        if (demo.parsed() && !(source->empty() && connect->empty())) {
            throw CLI::ValidationError("demo", "it is shown alone, without another source");
        }
        if (!demo.parsed() && source->empty() && !speed->empty()) {
            throw CLI::ValidationError("--speed", "only a recording or a demo has a speed");
        }
    });
    app.footer(kWebFooter);
}

} // namespace pallax
