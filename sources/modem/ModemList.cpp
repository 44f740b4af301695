#include "sources/modem/ModemList.h"

#include "sources/modem/BusValues.h"
#include "sources/modem/ModemChoice.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemObjects.h"
#include "sources/modem/ModemWords.h"
#include "sources/modem/ShownText.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <vector>

namespace pallax {

namespace {

using namespace bus_values;

constexpr std::string_view kMissing = "-";

/// More modems are counted in sentences.
constexpr std::size_t kMostNamed = 5;

constexpr std::size_t kColumns = 5;
using Row = std::array<std::string, kColumns>;

std::string textOr(const DictionaryRef& values, std::string_view key, std::string_view otherwise) {
    const auto text = values != nullptr ? textIn(*values, key) : std::nullopt;
    return text ? shownText(*text) : std::string(otherwise);
}

std::string indexOf(const std::string& path) {
    return path.substr(path.rfind('/') + 1);
}

std::string modelOf(const ModemObjects& objects, const std::string& path) {
    return textOr(dictionaryIn(*objects.find(path), modem_names::kModem), "Model", "unknown");
}

std::string_view wordOfCells(const BusReply& reply) {
    if (reply) {
        return "cells";
    }
    if (reply.error().isDenied()) {
        return "cells not permitted";
    }
    return reply.error().isUnsupported() ? "" : "cells unknown";
}

std::string abilitiesOf(const Dictionary& modem, bool isEnabled, const std::string& path,
                        const AskForCells& askForCells) {
    std::string abilities = "signal quality";
    const auto add = [&abilities](std::string_view ability) {
        abilities.append(ability.empty() ? "" : ", ").append(ability);
    };
    if (modem.contains(modem_names::kSignal)) {
        add("levels");
    }
    const DictionaryRef location = dictionaryIn(modem, modem_names::kLocation);
    constexpr std::int64_t kCellSource = 1;
    if (location != nullptr &&
        (integerIn(*location, "Capabilities").value_or(0) & kCellSource) != 0) {
        add("location");
    }
    add(isEnabled ? wordOfCells(askForCells(path)) : "");
    return abilities;
}

Row rowOf(const ModemObjects& objects, const std::string& path, const AskForCells& askForCells) {
    const Dictionary& interfaces = *objects.find(path);
    const DictionaryRef modem = dictionaryIn(interfaces, modem_names::kModem);
    const std::int64_t state = modem != nullptr ? integerIn(*modem, "State").value_or(0) : 0;
    return {indexOf(path), modelOf(objects, path), std::string(modem_words::ofState(state)),
            textOr(dictionaryIn(interfaces, modem_names::kModem3gpp), "OperatorName", kMissing),
            abilitiesOf(interfaces, state >= modem_names::kEnabled, path, askForCells)};
}

} // namespace

std::string modemList(const ModemObjects& objects, const AskForCells& askForCells) {
    std::vector<Row> rows{{"INDEX", "MODEL", "STATE", "OPERATOR", "TELLS"}};
    for (const std::string& path : objects.modems()) {
        rows.push_back(rowOf(objects, path, askForCells));
    }
    std::array<std::size_t, kColumns> widths{};
    for (const Row& row : rows) {
        for (std::size_t column = 0; column < kColumns; ++column) {
            widths.at(column) = std::max(widths.at(column), row.at(column).size());
        }
    }
    std::string list;
    for (const Row& row : rows) {
        for (std::size_t column = 0; column + 1 < kColumns; ++column) {
            list += row.at(column);
            list.append(widths.at(column) - row.at(column).size() + 2, ' ');
        }
        list.append(row.back()).append("\n");
    }
    return list;
}

std::string missingModemSentence(std::string_view wanted, const ModemObjects& objects) {
    const std::vector<std::string> paths = objects.modems();
    if (paths.empty()) {
        return wanted == ModemChoice::kAuto
                   ? "ModemManager has no modem; Pallax waits for one."
                   : formatText("There is no modem \"%@\": ModemManager has none.", {wanted});
    }
    std::string names;
    for (std::size_t index = 0; index < std::min(paths.size(), kMostNamed); ++index) {
        names += formatText("%@%@ (%@)", {index > 0 ? ", " : "", indexOf(paths[index]),
                                          modelOf(objects, paths[index])});
    }
    if (paths.size() > kMostNamed) {
        names += formatText(" and %zu more", {paths.size() - kMostNamed});
    }
    return formatText("There is no modem \"%@\": ModemManager has %@.", {wanted, names});
}

std::string_view cellPolicy() {
    return R"(<!DOCTYPE busconfig PUBLIC "-//freedesktop//DTD D-BUS Bus Configuration 1.0//EN"
 "http://www.freedesktop.org/standards/dbus/1.0/busconfig.dtd">
<!-- Lets every user of this machine ask ModemManager for the cells that a modem receives, which
     the bus reserves for root. ModemManager then asks polkit, which allows it to users who sit at
     the machine. An administrator saves this as /etc/dbus-1/system.d/pallax-cells.conf. The context
     is mandatory because the bus reads the files of that folder in any order. -->
<busconfig>
  <policy context="mandatory">
    <allow send_destination="org.freedesktop.ModemManager1"
           send_interface="org.freedesktop.ModemManager1.Modem"
           send_member="GetCellInfo"/>
  </policy>
</busconfig>
)";
}

} // namespace pallax
