#include "sources/modem/ModemPicture.h"

#include "sources/modem/BusValues.h"
#include "sources/modem/ModemCells.h"
#include "sources/modem/ModemIdentities.h"
#include "sources/modem/ModemLevels.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemSections.h"
#include "sources/modem/ModemView.h"
#include "sources/modem/ModemWords.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <string>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

using namespace bus_values;
using namespace modem_sections;
using modem_names::kEnabled;

/// The levels that the interface Signal tells of a system.
struct SignalGroup {
    std::string_view property;
    std::string_view system; ///< as in ModemCell
    std::string_view name;   ///< as in the display
};
constexpr auto kGroups = std::to_array<SignalGroup>({
    {"Gsm", "GSM", "GSM "},
    {"Umts", "UMTS", "UMTS "},
    {"Lte", "LTE", "LTE "},
    {"Nr5g", "NR", "NR "},
    {"Cdma", "CDMA", "1x "},
    {"Evdo", "", "EV-DO "},
});

struct Level {
    std::string_view key;
    std::string_view name;
    LevelKind kind;
};
constexpr auto kLevels = std::to_array<Level>({
    {"rssi", "RSSI", LevelKind::Rssi},
    {"rscp", "RSCP", LevelKind::Rscp},
    {"ecio", "Ec/Io", LevelKind::EcIo},
    {"rsrp", "RSRP", LevelKind::Rsrp},
    {"rsrq", "RSRQ", LevelKind::Rsrq},
    {"snr", "SINR", LevelKind::Sinr},
    {"sinr", "SINR", LevelKind::Sinr},
    {"io", "Io", LevelKind::Rssi},
});

/// Why there is no answer, for the display; empty if there is one.
std::string_view reasonOf(Access access) {
    switch (access) {
    case Access::Granted:
        return "";
    case Access::Denied:
        return "not permitted";
    case Access::Unsupported:
        return "not supported by this modem";
    case Access::Failed:
        return "no answer";
    case Access::NotAsked:
        break;
    }
    return "not yet known";
}

class Painter {
public:
    Painter(const ModemView& view, bool withIdentities)
        : _view(view), _withIdentities(withIdentities), _modem(interfaceNamed(modem_names::kModem)),
          _gpp(interfaceNamed(modem_names::kModem3gpp)),
          _cdma(interfaceNamed(modem_names::kModemCdma)), _cells(cellsIn(view.cells)) {
        const auto technologies = integerIn(*_modem, "AccessTechnologies").value_or(0);
        _technologies = modem_words::ofTechnologies(technologies);
        _system = modem_words::systemOf(technologies);
        const ModemCell* cell = servingCell();
        if (_system.empty() && cell != nullptr) {
            _system = cell->technology;
            _technologies = _system;
        }
    }

    Dictionary picture() const {
        Dictionary picture;
        picture.setFixed("Registration", registration());
        picture.setFixed("Signal", signal());
        picture.setFixed("Serving Cell", serving());
        const ModemCell* first = servingCell();
        picture.setFixed("Further Serving Cells", list([first](const ModemCell& cell) {
                             return cell.isServing && &cell != first;
                         }));
        picture.setFixed("Neighbour Cells",
                         list([](const ModemCell& cell) { return !cell.isServing; }));
        picture.setFixed("Data Connections", connectionsOf(_view));
        picture.setFixed("SIM", simOf(_view, _withIdentities));
        picture.setFixed("Modem", modemOf(_view, _withIdentities));
        return picture;
    }

private:
    DictionaryRef interfaceNamed(std::string_view name) const {
        return modem_sections::interfaceNamed(_view, name);
    }
    bool isThere() const { return _view.presence == ModemView::Presence::There; }
    bool isEnabled() const { return integerIn(*_modem, "State").value_or(0) >= kEnabled; }

    const ModemCell* servingCell() const {
        const ModemCell* serving = nullptr;
        for (const ModemCell& cell : _cells) {
            if (cell.isServing && (serving == nullptr || (cell.isPrimary && !serving->isPrimary))) {
                serving = &cell;
            }
        }
        return serving;
    }

    std::string technologies() const {
        return _technologies.empty() ? std::string(kUnknown) : _technologies;
    }

    Dictionary registration() const;
    void addRejection(Dictionary& section) const;
    Dictionary signal() const;
    /// Appends the levels of a group under their names.
    void addLevels(Dictionary& section, const SignalGroup& group, std::string_view prefix) const;
    std::string_view whyNoLevels() const;
    Dictionary serving() const;
    void addLocation(Dictionary& section) const;
    void addServingLevels(Dictionary& section) const;
    std::string_view whyNoCells() const;
    template <class Wanted>
    Array list(Wanted wanted) const;

    const ModemView& _view;
    bool _withIdentities;
    DictionaryRef _modem;
    DictionaryRef _gpp;
    DictionaryRef _cdma;
    std::vector<ModemCell> _cells;
    std::string _technologies;
    std::string_view _system;
};

Dictionary Painter::registration() const {
    Dictionary section;
    const auto state = integerIn(*_gpp, "RegistrationState");
    const auto oneX = integerIn(*_cdma, "Cdma1xRegistrationState");
    const auto evdo = integerIn(*_cdma, "EvdoRegistrationState");
    std::string_view word = isThere() ? kUnknown : absenceOf(_view);
    if (state) {
        word = modem_words::ofRegistration(*state);
    } else if (oneX.value_or(0) > 0 || evdo.value_or(0) > 0) {
        word = modem_words::ofCdmaRegistration(oneX.value_or(0) > 0 ? *oneX : *evdo);
    }
    addWord(section, "State", word);
    section.setFixed("Technology", technologies());
    add(section, "Operator", *_gpp, "OperatorName");
    add(section, "Operator Code", *_gpp, "OperatorCode");
    const Dictionary cell = serving();
    for (const std::string_view key : {"LAC", "TAC", "Cell ID"}) {
        if (const PropertyList* value = cell.find(key)) {
            section.setFixed(key, *value);
        }
    }
    if (oneX || evdo) {
        addWord(section, "1x", modem_words::ofCdmaRegistration(oneX.value_or(0)));
        addWord(section, "EV-DO", modem_words::ofCdmaRegistration(evdo.value_or(0)));
        addNumber(section, "SID", *_cdma, "Sid", "%lld");
        addNumber(section, "NID", *_cdma, "Nid", "%lld");
    }
    if (const auto packets = integerIn(*_gpp, "PacketServiceState"); packets.value_or(0) > 0) {
        addWord(section, "Packet Service", modem_words::ofPacketService(*packets));
    }
    addRejection(section);
    return section;
}

/// The cause of 3GPP TS 24.008 or 24.301 that the network gave.
void Painter::addRejection(Dictionary& section) const {
    const DictionaryRef rejection = dictionaryIn(*_gpp, "NetworkRejection");
    if (rejection != nullptr && integerIn(*rejection, "error").value_or(0) > 0) {
        addNumber(section, "Rejection", *rejection, "error", "cause %lld");
    }
}

void Painter::addLevels(Dictionary& section, const SignalGroup& group,
                        std::string_view prefix) const {
    const DictionaryRef told = dictionaryIn(*interfaceNamed(modem_names::kSignal), group.property);
    if (told == nullptr) {
        return;
    }
    for (const Level& level : kLevels) {
        const auto value = realIn(*told, level.key);
        const auto text = value ? levelText(level.kind, *value) : std::nullopt;
        if (text) {
            section.set(Text(std::string(prefix).append(level.name)), *text);
        }
    }
}

std::string_view Painter::whyNoLevels() const {
    if (!isThere()) {
        return absenceOf(_view);
    }
    if (!_view.interfaces.contains(modem_names::kSignal)) {
        return reasonOf(Access::Unsupported);
    }
    if (!isEnabled()) {
        return "the modem is not enabled";
    }
    return _view.levelAccess == Access::Granted ? "none" : reasonOf(_view.levelAccess);
}

Dictionary Painter::signal() const {
    Dictionary section;
    const ArrayRef quality = arrayIn(*_modem, "SignalQuality");
    const auto percent = quality != nullptr && !quality->empty() ? (*quality)[0].integer()
                                                                 : std::optional<std::int64_t>();
    const auto recent =
        quality != nullptr && quality->size() > 1 ? (*quality)[1].boolean() : std::optional<bool>();
    constexpr std::int64_t kMost = 100;
    const bool isKnown = percent && *percent >= 0 && *percent <= kMost;
    section.setFixed("Quality",
                     isKnown ? formatText("%lld %%", {*percent}) : std::string(kUnknown));
    addWord(section, "Recent", recent.value_or(false) ? "yes" : "no");
    const std::size_t without = section.size();
    for (const SignalGroup& group : kGroups) {
        addLevels(section, group, group.name);
    }
    if (section.size() == without) {
        addWord(section, "Levels", whyNoLevels());
    }
    return section;
}

std::string_view Painter::whyNoCells() const {
    if (!isThere()) {
        return absenceOf(_view);
    }
    if (!isEnabled()) {
        return "the modem is not enabled";
    }
    return _view.cellAccess == Access::Granted ? "no serving cell" : reasonOf(_view.cellAccess);
}

/// "MCC,MNC,LAC,CI,TAC", the last three hexadecimal, and "0" where there is none.
void Painter::addLocation(Dictionary& section) const {
    constexpr std::size_t kParts = 5;
    const auto text = textIn(_view.location, "1");
    std::vector<std::string> parts(1);
    for (const char character : text.value_or("")) {
        if (character == ',') {
            parts.emplace_back();
        } else {
            parts.back() += character;
        }
    }
    if (parts.size() != kParts) {
        return;
    }
    const auto isDigits = [](const std::string& part) {
        return !part.empty() && part.size() <= 3 &&
               part.find_first_not_of("0123456789") == std::string::npos;
    };
    if (isDigits(parts[0]) && isDigits(parts[1])) {
        section.setFixed("Operator Code", parts[0] + parts[1]);
    }
    const auto addPart = [&section](std::string_view key, const std::string& part,
                                    std::int64_t most) {
        const auto number = hexadecimalIn(part);
        if (number && *number > 0 && *number <= most) {
            section.setFixed(key, std::to_string(*number));
        }
    };
    constexpr std::int64_t kMostLac = 0xFFFF;
    constexpr std::int64_t kMostTac = 0xFFFFFF;
    constexpr std::int64_t kMostCell = 0xFFFFFFFFF;
    addPart("LAC", parts[2], kMostLac);
    addPart("TAC", parts[4], kMostTac);
    addPart("Cell ID", parts[3], kMostCell);
}

/// The levels of the serving cell's system, where the cell information has none.
void Painter::addServingLevels(Dictionary& section) const {
    for (const SignalGroup& group : kGroups) {
        if (_system.empty() || group.system != _system) {
            continue;
        }
        Dictionary levels;
        addLevels(levels, group, "");
        for (const Dictionary::Entry& level : levels) {
            const bool isRxLevel = _system == "GSM" && level.key.view() == "RSSI";
            const Text key = isRxLevel ? Text::fixed("Rx Level") : level.key;
            if (!section.contains(key.view())) {
                section.set(key, level.value);
            }
        }
    }
}

Dictionary Painter::serving() const {
    Dictionary section;
    section.setFixed("Source", "");
    section.setFixed("Technology", _system.empty() ? std::string(kUnknown) : std::string(_system));
    const ModemCell* cell = servingCell();
    if (cell != nullptr) {
        addWord(section, "Source", "cell information");
        addWord(section, "Technology", cell->technology);
        for (const Dictionary::Entry& value : cell->values) {
            section.set(value.key, value.value);
        }
        if (cell->technology == _system) {
            addServingLevels(section);
        }
        return section;
    }
    addLocation(section);
    const bool isLocated = section.contains("Cell ID");
    addWord(section, "Source", isLocated ? "location only" : whyNoCells());
    if (isLocated) {
        addWord(section, "Cell Information", whyNoCells());
    }
    addServingLevels(section);
    return section;
}

template <class Wanted>
Array Painter::list(Wanted wanted) const {
    Array entries{"Technology, Channel, Cell"};
    for (const ModemCell& cell : _cells) {
        if (wanted(cell)) {
            Dictionary entry;
            addWord(entry, "Technology", cell.technology);
            for (const Dictionary::Entry& value : cell.values) {
                entry.set(value.key, value.value);
            }
            entries.emplace_back(std::move(entry));
        }
    }
    return entries;
}

} // namespace

Dictionary pictureOf(const ModemView& view, bool withIdentities) {
    const Dictionary picture = Painter(view, withIdentities).picture();
    return withIdentities ? picture : withoutIdentities(picture, view);
}

} // namespace pallax
