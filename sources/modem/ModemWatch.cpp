#include "sources/modem/ModemWatch.h"

#include "sources/modem/BusValues.h"
#include "sources/modem/ModemNames.h"

#include <algorithm>
#include <limits>
#include <utility>

namespace pallax {

namespace {

using namespace bus_values;
using namespace modem_names;

constexpr std::size_t kMostBearers = 32;
constexpr const char* kProperties = "org.freedesktop.DBus.Properties";

} // namespace

ModemWatch::ModemWatch(Setup setup)
    : _setup(std::move(setup)), _choice(_setup.wanted), _era(std::make_shared<int>()) {}

void ModemWatch::managerCame(const PropertyList& objects) {
    _objects.replace(objects);
    forgetModem();
    _view.presence = ModemView::Presence::Waiting;
    choose();
}

void ModemWatch::managerLeft(ModemView::Presence why) {
    _objects.clear();
    forgetModem();
    _view.presence = why;
    _setup.changed();
}

void ModemWatch::interfacesAdded(const std::string& path, const Dictionary& interfaces) {
    _objects.add(path, interfaces);
    choose();
}

void ModemWatch::interfacesRemoved(const std::string& path,
                                   const std::vector<std::string>& interfaces) {
    _objects.remove(path, interfaces);
    choose();
}

void ModemWatch::propertiesChanged(const std::string& path, const std::string& interface,
                                   const Dictionary& properties) {
    const auto update = [&properties](Dictionary& known) {
        for (const Dictionary::Entry& property : properties) {
            if (known.size() < ModemObjects::kMostProperties ||
                known.contains(property.key.view())) {
                known.set(property.key, property.value);
            }
        }
    };
    if (path == _simPath && interface == kSim) {
        update(_view.sim);
    }
    const auto bearer = std::find(_bearerPaths.begin(), _bearerPaths.end(), path);
    if (bearer != _bearerPaths.end() && interface == kBearer) {
        update(_view.bearers[static_cast<std::size_t>(bearer - _bearerPaths.begin())]);
    }
    if (_objects.change(path, interface, properties) && _path.empty()) {
        choose(); // its model may have become known
    } else if (path == _path) {
        readModem();
    }
    _setup.changed();
}

/// Finds the modem, which may have come, gone or come back.
void ModemWatch::choose() {
    const std::string path = _choice.in(_objects).value_or("");
    if (path != _path) {
        forgetModem();
        _path = path;
    }
    if (!_path.empty()) {
        _view.presence = ModemView::Presence::There;
        readModem();
    } else {
        _view.presence =
            _choice.isKnown() ? ModemView::Presence::Unplugged : ModemView::Presence::Waiting;
    }
    _setup.changed();
}

void ModemWatch::forgetModem() {
    ModemView view;
    view.model = std::move(_view.model);
    view.equipment = std::move(_view.equipment);
    _view = std::move(view);
    _path.clear();
    _simPath.clear();
    _bearerPaths.clear();
    _wasEnabled = false;
    _cells = _location = _rate = Question();
    _locationAccess = Access::NotAsked;
    _rateBefore.reset();
    _era = std::make_shared<int>();
}

std::optional<std::int64_t> ModemWatch::number(const char* interface, const char* property) const {
    const DictionaryRef properties = dictionaryIn(_view.interfaces, interface);
    return properties != nullptr ? integerIn(*properties, property) : std::nullopt;
}

bool ModemWatch::isEnabled() const {
    return number(kModem, "State").value_or(0) >= kEnabled;
}

void ModemWatch::readModem() {
    _view.interfaces = *_objects.find(_path);
    if (const DictionaryRef modem = dictionaryIn(_view.interfaces, kModem)) {
        _view.model = textIn(*modem, "Model").value_or(_view.model);
        _view.equipment = textIn(*modem, "EquipmentIdentifier").value_or(_view.equipment);
    }
    readSim();
    readBearers();
    const bool isNowEnabled = isEnabled();
    if (isNowEnabled != std::exchange(_wasEnabled, isNowEnabled)) {
        _cells.due = _location.due = _rate.due = SteadyTime(); // another answer may come now
        _view.cellAccess = _view.levelAccess = _locationAccess = Access::NotAsked;
        _view.cells.clear();
    }
    if (const DictionaryRef location = dictionaryIn(_view.interfaces, kLocation);
        location != nullptr && truthIn(*location, "SignalsLocation").value_or(false)) {
        const DictionaryRef told = dictionaryIn(*location, "Location");
        _view.location = told != nullptr ? *told : Dictionary();
    }
}

void ModemWatch::readSim() {
    const DictionaryRef modem = dictionaryIn(_view.interfaces, kModem);
    const std::string path = modem != nullptr ? textIn(*modem, "Sim").value_or(kNoObject) : "";
    if (path == _simPath) {
        return;
    }
    _simPath = path;
    _view.sim = Dictionary();
    if (path != kNoObject) {
        askForAll(path, kSim, [this, path](const Dictionary& properties) {
            if (path == _simPath) {
                _view.sim = properties;
            }
        });
    }
}

void ModemWatch::readBearers() {
    std::vector<std::string> paths;
    const auto add = [&paths](const PropertyList& path) {
        const std::string text = path.string().value_or(kNoObject);
        const bool isNew = std::find(paths.begin(), paths.end(), text) == paths.end();
        if (text != kNoObject && isNew && paths.size() < kMostBearers) {
            paths.push_back(text);
        }
    };
    if (const DictionaryRef modem = dictionaryIn(_view.interfaces, kModem)) {
        if (const ArrayRef told = arrayIn(*modem, "Bearers")) {
            std::for_each(told->begin(), told->end(), add);
        }
    }
    if (const DictionaryRef gpp = dictionaryIn(_view.interfaces, kModem3gpp)) {
        if (const PropertyList* initial = gpp->find("InitialEpsBearer")) {
            add(*initial);
        }
    }
    if (paths == _bearerPaths) {
        return;
    }
    std::vector<Dictionary> bearers(paths.size());
    for (std::size_t index = 0; index < paths.size(); ++index) {
        const auto known = std::find(_bearerPaths.begin(), _bearerPaths.end(), paths[index]);
        if (known != _bearerPaths.end()) {
            bearers[index] = _view.bearers[static_cast<std::size_t>(known - _bearerPaths.begin())];
            continue;
        }
        askForAll(paths[index], kBearer, [this, path = paths[index]](const Dictionary& told) {
            const auto at = std::find(_bearerPaths.begin(), _bearerPaths.end(), path);
            if (at != _bearerPaths.end()) {
                _view.bearers[static_cast<std::size_t>(at - _bearerPaths.begin())] = told;
            }
        });
    }
    _bearerPaths = std::move(paths);
    _view.bearers = std::move(bearers);
}

/// Asks once for the properties of an object that is not among the managed ones.
void ModemWatch::askForAll(const std::string& path, const char* interface,
                           std::function<void(const Dictionary&)> take) {
    BusCall call{path, kProperties, "GetAll"};
    call.text = interface;
    _setup.ask(call,
               [this, era = std::weak_ptr(_era), take = std::move(take)](const BusReply& reply) {
                   const DictionaryRef properties = reply ? reply->dictionary() : nullptr;
                   if (!era.expired() && properties != nullptr) {
                       take(*properties);
                       _setup.changed();
                   }
               });
}

void ModemWatch::look() {
    if (_path.empty()) {
        return;
    }
    lookAtRate();
    lookAtCells();
    lookAtLocation();
}

bool ModemWatch::isDue(const Question& question) const {
    return isEnabled() && !question.isAsked && _setup.now() >= question.due;
}

/// Asks a question whose answer tells whether it can be asked again.
void ModemWatch::ask(BusCall call, Question& question, Access& access,
                     std::function<void(const PropertyList&)> take) {
    question.isAsked = true;
    _setup.ask(call, [this, era = std::weak_ptr(_era), &question, &access,
                      take = std::move(take)](const BusReply& reply) {
        if (era.expired()) {
            return; // of a modem that has gone
        }
        question.isAsked = false;
        if (reply) {
            access = Access::Granted;
            question.due = _setup.now() + kCellInterval;
            take(*reply);
        } else {
            access = reply.error().isDenied()        ? Access::Denied
                     : reply.error().isUnsupported() ? Access::Unsupported
                                                     : Access::Failed;
            question.due = access == Access::Failed ? _setup.now() + kPause : SteadyTime::max();
            take(PropertyList());
        }
        _setup.changed();
    });
}

void ModemWatch::lookAtRate() {
    const auto rate = number(kSignal, "Rate");
    const bool isSlow = rate && (*rate <= 0 || *rate > kRate);
    if (rate && !isSlow && _view.levelAccess == Access::NotAsked) {
        _view.levelAccess = Access::Granted; // somebody else polls
        _setup.changed();
    }
    if (!isSlow || !isDue(_rate)) {
        return;
    }
    BusCall call{_path, kSignal, "Setup"};
    call.number = kRate;
    constexpr std::int64_t kMostRate = std::numeric_limits<std::uint32_t>::max();
    const auto before = static_cast<std::uint32_t>(std::clamp<std::int64_t>(*rate, 0, kMostRate));
    const auto first = _rateBefore;
    _rateBefore = first.value_or(before);
    ask(std::move(call), _rate, _view.levelAccess, [this, first](const PropertyList&) {
        if (_view.levelAccess != Access::Granted) {
            _rateBefore = first;
        }
    });
}

void ModemWatch::lookAtCells() {
    if (isDue(_cells)) {
        ask({_path, kModem, "GetCellInfo"}, _cells, _view.cellAccess,
            [this](const PropertyList& told) {
                const ArrayRef cells = told.array();
                _view.cells = cells != nullptr ? *cells : Array();
            });
    }
}

/// Where the location's property stays empty, a call gives it.
void ModemWatch::lookAtLocation() {
    constexpr std::int64_t kCellSource = 1;
    const DictionaryRef location = dictionaryIn(_view.interfaces, kLocation);
    const bool isAsked = location != nullptr &&
                         !truthIn(*location, "SignalsLocation").value_or(false) &&
                         (integerIn(*location, "Enabled").value_or(0) & kCellSource) != 0;
    if (isAsked && isDue(_location)) {
        ask({_path, kLocation, "GetLocation"}, _location, _locationAccess,
            [this](const PropertyList& told) {
                const DictionaryRef values = told.dictionary();
                _view.location = values != nullptr ? *values : Dictionary();
            });
    }
}

std::optional<BusCall> ModemWatch::farewell() const {
    const bool isOurs = _rate.isAsked || number(kSignal, "Rate") == kRate;
    if (!_rateBefore || _path.empty() || !isOurs) {
        return std::nullopt; // or another program has set another rate
    }
    BusCall call{_path, kSignal, "Setup"};
    call.number = _rateBefore;
    return call;
}

} // namespace pallax
