#include "cli/ModemOptions.h"

#include "cli/OptionParts.h"
#include "sources/modem/ModemChoice.h"

#include <CLI/CLI.hpp>

namespace pallax {

namespace {

constexpr const char* kModemFooter = R"(Examples:
  pallax modem                         the first modem that is enabled
  pallax modem MB-5                    another one, by its model
  pallax modem --list
  pallax record --modem drive.pcapng

Shows a modem of this machine through ModemManager, which must run: the network,
levels, serving and neighbour cells, data connections and the SIM, as far as the
modem tells them. MODEM is a model, an index or an object path; a modem that
comes back after it was unplugged is found again.

Pallax only watches. It never enables, connects or unlocks a modem. Where nobody
polls the levels, it lets ModemManager poll them every two seconds, and puts
that back when it ends.

Without --with-identities, the stream leaves out IMSI, IMEI, ICCID and the own
number, because recordings travel.

The system bus lets only root ask for cells. With the policy that --policy
prints, saved as /etc/dbus-1/system.d/pallax-cells.conf by an administrator,
users who sit at the machine may ask, too. Nothing installs it.

Exit status:
  0   success, or the reader of the output has gone
  1   failure: no system bus, or no such modem; nothing to list
  2   wrong usage)";

/// The option's value if it is given without one.
std::string orAuto(const std::string& text) {
    return text.empty() ? ModemChoice::kAuto : text;
}

void addIdentities(CLI::App& app, const std::function<LocalModem&()>& modem, CLI::Option* needed) {
    CLI::Option* identities = app.add_flag_callback(
        "--with-identities", [modem] { modem().withIdentities = true; },
        "Show IMSI, IMEI, ICCID and the own number, too");
    if (needed != nullptr) {
        identities->needs(needed);
    }
}

} // namespace

CLI::Option* addModemSource(CLI::App& app, const std::function<LocalModem&()>& modem,
                            const std::string& description) {
    CLI::Option* option =
        app.add_option_function<std::string>(
               "--modem", [modem](const std::string& text) { modem().wanted = orAuto(text); },
               description)
            ->expected(0, 1)
            ->type_name("[PATH|INDEX|MODEL|auto]");
    addIdentities(app, modem, option);
    return option;
}

void addModem(CLI::App& app, ModemRequest& request) {
    const auto modem = [&request]() -> LocalModem& {
        auto* local = std::get_if<LocalModem>(&request.browse.source);
        return local != nullptr ? *local : request.browse.source.emplace<LocalModem>();
    };
    modem().wanted = ModemChoice::kAuto;
    app.add_option_function<std::string>(
           "MODEM", [modem](const std::string& text) { modem().wanted = orAuto(text); },
           "The modem to browse: a model, an index or an object path (default: the first one that "
           "is enabled)")
        ->type_name("");
    addIdentities(app, modem, nullptr);
    CLI::Option* list =
        app.add_flag("--list", request.list, "List the modems and what they can tell");
    app.add_flag("--policy", request.policy,
                 "Print the bus policy that lets users ask for cells, for an administrator")
        ->excludes(list);
    addView(app, request.browse);
    app.footer(kModemFooter);
}

ParsedOptions modemOptions(const ModemRequest& request) {
    if (request.list) {
        return ModemListOptions();
    }
    if (request.policy) {
        return ModemPolicyOptions();
    }
    return request.browse;
}

} // namespace pallax
