#include "sources/ModemStream.h"

#include "host/AsioMainQueue.h"
#include "host/WallClock.h"
#include "platform/TelephonyConstants.h"
#include "sources/modem/ModemBus.h"
#include "sources/modem/ModemList.h"
#include "sources/modem/ModemPicture.h"
#include "sources/modem/ShownText.h"
#include "text/Format.h"

#include <chrono>
#include <utility>

namespace pallax {

namespace {

using namespace std::chrono_literals;

constexpr auto kModemLookInterval = 1s;
/// Looks until the bus is tried again.
constexpr int kLooksBetweenTries = 5;
/// At the end, nobody waits longer for ModemManager.
constexpr auto kFarewellPatience = 1000ms;
constexpr auto kStartPatience = 5000ms;

Result<ModemStream::Bus, HostError> openBus(AsioMainQueue& queue) {
    auto opened = ModemBus::open(queue);
    if (!opened) {
        return opened.error();
    }
    const std::shared_ptr<ModemBus> bus = std::move(opened).value();
    return ModemStream::Bus{
        [bus](const BusCall& call) { return bus->callNow(call); },
        [bus](const BusCall& call, std::function<void(const BusReply&)> answer) {
            bus->call(call, std::move(answer));
        },
        [bus] { bus->askForObjects(); },
        [bus](ModemWatch& watch, std::function<void()> lost) {
            bus->follow(watch, std::move(lost));
        }};
}

} // namespace

/// One reader of the stream.
class ModemStream::Reader final : public PacketSource {
public:
    explicit Reader(std::shared_ptr<ModemStream> stream) : _stream(std::move(stream)) {}

    std::string technology() const override { return std::string(kHXLogChannelTechnology_IFX); }
    Next next() override {
        if (_stream->_messages.count() == _seen) {
            return {State::Later, std::nullopt};
        }
        _seen = _stream->_messages.count();
        _current = _stream->_messages.latest();
        return {State::Packet, Packet{_stream->_messages.time(), *_current}};
    }
    void whenReady(std::function<void()> ready) override {
        if (_stream->_messages.count() != _seen) {
            _stream->_setup.queue.async(std::move(ready));
        } else {
            _stream->_waiting.push_back(std::move(ready));
        }
    }
    bool restart() override { return false; }
    std::string failure() const override { return {}; }

private:
    std::shared_ptr<ModemStream> _stream;
    std::uint64_t _seen = 0;
    std::shared_ptr<const ByteBuffer> _current;
};

Result<std::shared_ptr<ModemStream>, HostError>
ModemStream::open(AsioMainQueue& queue, const LocalModem& modem, const Report& report) {
    static const WallClock clock;
    return open({queue, queue, clock, std::chrono::steady_clock::now,
                 [&queue] { return pallax::openBus(queue); }},
                modem, report);
}

Result<std::shared_ptr<ModemStream>, HostError>
ModemStream::open(Setup setup, const LocalModem& modem, const Report& report) {
    auto bus = setup.openBus();
    if (!bus) {
        return bus.error();
    }
    std::shared_ptr<ModemStream> stream(
        new ModemStream(std::move(setup), modem, std::move(bus).value()));
    if (auto refusal = stream->begin(modem, report)) {
        return std::move(*refusal);
    }
    return stream;
}

ModemStream::ModemStream(Setup setup, const LocalModem& modem, Bus bus)
    : _setup(std::move(setup)),
      _watch({[this](const BusCall& call, std::function<void(const BusReply&)> answer) {
                  if (_bus) {
                      _bus->call(call, std::move(answer));
                  }
              },
              _setup.now, [this] { _messages.changed(); }, modem.wanted}),
      _messages(
          {_setup.queue, _setup.clock,
           [this, isWhole = modem.withIdentities] { return pictureOf(_watch.view(), isWhole); },
           [this] { tell(); }}),
      _bus(std::move(bus)) {}

ModemStream::~ModemStream() {
    auto farewell = _watch.farewell();
    if (farewell && _bus) {
        farewell->patience = kFarewellPatience;
        (void)_bus->callNow(*farewell);
    }
}

std::optional<HostError> ModemStream::begin(const LocalModem& modem, const Report& report) {
    BusCall question = ModemBus::managedObjects();
    question.patience = kStartPatience;
    const BusReply objects = _bus->callNow(question);
    if (objects) {
        _watch.managerCame(*objects);
        if (_watch.view().presence != ModemView::Presence::There) {
            const std::string sentence = missingModemSentence(modem.wanted, _watch.objects());
            if (modem.wanted != ModemChoice::kAuto) {
                return HostError{sentence};
            }
            report(sentence);
        }
    } else if (objects.error().isDenied()) {
        return HostError{"This user may not ask ModemManager: the system bus rejects it."};
    } else {
        const bool isSilent = objects.error().isUnanswered();
        _watch.managerLeft(isSilent ? ModemView::Presence::NoAnswer
                                    : ModemView::Presence::NoManager);
        report(isSilent ? "ModemManager does not answer; Pallax asks again."
                        : "ModemManager is not running; Pallax waits for it.");
    }
    _bus->follow(_watch, [this] { lost(); });
    if (!objects) {
        _bus->askForObjects();
    }
    _looks = _setup.timers.scheduleRepeating(kModemLookInterval, [this] { look(); });
    look();
    return std::nullopt;
}

void ModemStream::lost() {
    _bus.reset();
    _looksWithoutBus = 0;
    _watch.managerLeft(ModemView::Presence::NoBus);
}

void ModemStream::look() {
    if (_bus) {
        _watch.look();
        return;
    }
    if (++_looksWithoutBus % kLooksBetweenTries != 0) {
        return;
    }
    if (auto opened = _setup.openBus()) {
        _bus = std::move(opened).value();
        _bus->follow(_watch, [this] { lost(); });
        _bus->askForObjects();
    }
}

void ModemStream::tell() {
    for (auto& ready : std::exchange(_waiting, {})) {
        _setup.queue.async(std::move(ready));
    }
}

std::unique_ptr<PacketSource> ModemStream::reader() {
    return std::make_unique<Reader>(shared_from_this());
}

} // namespace pallax
