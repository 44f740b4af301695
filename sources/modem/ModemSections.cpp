#include "sources/modem/ModemSections.h"

#include "sources/modem/BusValues.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemView.h"
#include "sources/modem/ModemWords.h"
#include "sources/modem/ShownText.h"
#include "text/Format.h"

#include <memory>
#include <string>
#include <utility>

namespace pallax {

using namespace bus_values;
using namespace modem_sections;

namespace modem_sections {

DictionaryRef interfaceNamed(const ModemView& view, std::string_view name) {
    const DictionaryRef properties = dictionaryIn(view.interfaces, name);
    return properties != nullptr ? properties : std::make_shared<Dictionary>();
}

std::string_view absenceOf(const ModemView& view) {
    switch (view.presence) {
    case ModemView::Presence::NoBus:
        return "no system bus";
    case ModemView::Presence::NoManager:
        return "ModemManager is not running";
    case ModemView::Presence::NoAnswer:
        return "ModemManager does not answer";
    case ModemView::Presence::Unplugged:
        return "unplugged";
    default:
        return "no modem";
    }
}

void add(Dictionary& section, std::string_view key, const Dictionary& values,
         std::string_view property) {
    if (const auto text = textIn(values, property)) {
        section.setFixed(key, shownText(*text));
    }
}

void addWord(Dictionary& section, std::string_view key, std::string_view word) {
    if (!word.empty()) {
        section.setFixed(key, Text::fixed(word));
    }
}

void addNumber(Dictionary& section, std::string_view key, const Dictionary& values,
               std::string_view property, const char* format) {
    if (const auto number = integerIn(values, property); number && *number >= 0) {
        section.setFixed(key, formatText(format, {*number}));
    }
}

} // namespace modem_sections

Array connectionsOf(const ModemView& view) {
    Array entries{"State, Type"};
    for (const Dictionary& bearer : view.bearers) {
        Dictionary entry;
        const bool isSuspended = truthIn(bearer, "Suspended").value_or(false);
        const bool isConnected = truthIn(bearer, "Connected").value_or(false);
        addWord(entry, "State",
                isSuspended   ? "suspended"
                : isConnected ? "connected"
                              : "not connected");
        addWord(entry, "Type",
                modem_words::ofBearerType(integerIn(bearer, "BearerType").value_or(0)));
        add(entry, "Interface", bearer, "Interface");
        if (const DictionaryRef wanted = dictionaryIn(bearer, "Properties")) {
            add(entry, "APN", *wanted, "apn");
            addWord(entry, "IP Type",
                    modem_words::ofIpType(integerIn(*wanted, "ip-type").value_or(0)));
        }
        if (const DictionaryRef statistics = dictionaryIn(bearer, "Stats")) {
            addNumber(entry, "Duration", *statistics, "duration", "%lld s");
            addNumber(entry, "Received", *statistics, "rx-bytes", "%lld bytes");
            addNumber(entry, "Sent", *statistics, "tx-bytes", "%lld bytes");
        }
        entries.emplace_back(std::move(entry));
    }
    return entries;
}

Dictionary simOf(const ModemView& view, bool withIdentities) {
    const DictionaryRef modem = interfaceNamed(view, modem_names::kModem);
    Dictionary section;
    const std::string_view lock =
        modem_words::ofLock(integerIn(*modem, "UnlockRequired").value_or(0));
    const bool isLocked = integerIn(*modem, "State") == modem_names::kLocked;
    const auto path = textIn(*modem, "Sim");
    std::string_view state = view.presence != ModemView::Presence::There ? kUnknown : "none";
    if (path && *path != modem_names::kNoObject) {
        state = isLocked ? "locked" : "ready";
    }
    addWord(section, "State", state);
    addWord(section, "Active", truthIn(view.sim, "Active").value_or(false) ? "yes" : "no");
    addWord(section, "Lock", isLocked ? lock : std::string_view());
    add(section, "Operator", view.sim, "OperatorName");
    add(section, "Operator Code", view.sim, "OperatorIdentifier");
    if (withIdentities) {
        add(section, "IMSI", view.sim, "Imsi");
        add(section, "ICCID", view.sim, "SimIdentifier");
        add(section, "EID", view.sim, "Eid");
    }
    return section;
}

Dictionary modemOf(const ModemView& view, bool withIdentities) {
    const DictionaryRef modem = interfaceNamed(view, modem_names::kModem);
    const DictionaryRef gpp = interfaceNamed(view, modem_names::kModem3gpp);
    const DictionaryRef cdma = interfaceNamed(view, modem_names::kModemCdma);
    Dictionary section;
    const auto state = integerIn(*modem, "State");
    addWord(section, "State",
            view.presence == ModemView::Presence::There ? modem_words::ofState(state.value_or(0))
                                                        : absenceOf(view));
    section.setFixed("Model", view.model.empty() ? std::string(kUnknown) : shownText(view.model));
    add(section, "Model", *modem, "Model");
    add(section, "Manufacturer", *modem, "Manufacturer");
    add(section, "Revision", *modem, "Revision");
    if (state == modem_names::kFailed) {
        addWord(section, "Failure",
                modem_words::ofFailure(integerIn(*modem, "StateFailedReason").value_or(0)));
    }
    if (const auto power = integerIn(*modem, "PowerState")) {
        addWord(section, "Power", modem_words::ofPower(*power));
    }
    add(section, "Plugin", *modem, "Plugin");
    add(section, "Port", *modem, "PrimaryPort");
    if (withIdentities) {
        add(section, "Equipment ID", *modem, "EquipmentIdentifier");
        add(section, "IMEI", *gpp, "Imei");
        add(section, "MEID", *cdma, "Meid");
        add(section, "ESN", *cdma, "Esn");
        const ArrayRef numbers = arrayIn(*modem, "OwnNumbers");
        const auto own =
            numbers != nullptr && !numbers->empty() ? numbers->front().string() : std::nullopt;
        if (own) {
            section.setFixed("Own Number", shownText(*own));
        }
    }
    return section;
}

} // namespace pallax
