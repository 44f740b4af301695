#include "sources/modem/ModemBus.h"

#include "host/AsioMainQueue.h"
#include "sources/modem/BusMessage.h"
#include "sources/modem/ModemNames.h"
#include "sources/modem/ModemWatch.h"
#include "text/Format.h"

#include <array>
#include <cstring>
#include <ctime>
#include <limits>
#include <list>
#include <poll.h>
#include <string>
#include <string_view>
#include <utility>

namespace pallax {

namespace {

using namespace std::chrono_literals;

/// After this many messages, other blocks get their turn.
constexpr int kMessagesPerBlock = 200;
/// Before a question about all objects is asked again.
constexpr auto kRetry = 5s;

constexpr auto kMatches = std::to_array<const char*>({
    "type='signal',sender='org.freedesktop.ModemManager1',"
    "interface='org.freedesktop.DBus.ObjectManager',path='/org/freedesktop/ModemManager1'",
    "type='signal',sender='org.freedesktop.ModemManager1',"
    "interface='org.freedesktop.DBus.Properties',member='PropertiesChanged',"
    "path_namespace='/org/freedesktop/ModemManager1'",
    "type='signal',sender='org.freedesktop.DBus',interface='org.freedesktop.DBus',"
    "member='NameOwnerChanged',arg0='org.freedesktop.ModemManager1'",
});

BusError errorOf(int number) {
    return {"org.freedesktop.DBus.Error.Failed",
            std::strerror(-number)}; // NOLINT(concurrency-mt-unsafe)
}

std::chrono::microseconds monotonicNow() {
    timespec now{};
    (void)::clock_gettime(CLOCK_MONOTONIC, &now);
    return std::chrono::duration_cast<std::chrono::microseconds>(
        std::chrono::seconds(now.tv_sec) + std::chrono::nanoseconds(now.tv_nsec));
}

std::uint64_t microseconds(std::chrono::milliseconds time) {
    return static_cast<std::uint64_t>(std::chrono::microseconds(time).count());
}

} // namespace

struct ModemBus::Connection {
    /// A call that has not been answered.
    struct Pending {
        Connection& connection;
        std::function<void(const BusReply&)> answer;
        BusSlot slot = nullptr;
        std::list<Pending>::iterator place = {};
    };

    explicit Connection(AsioMainQueue& mainQueue) : queue(mainQueue) {}

    static int onAnswer(sd_bus_message* message, void* pending, sd_bus_error* error);
    static int onSignal(sd_bus_message* message, void* connection, sd_bus_error* error);

    bool connect();
    BusMessage messageOf(const BusCall& call) const;
    void send(const BusCall& call, std::function<void(const BusReply&)> answer);
    void take(std::string_view member, const Array& arguments, const std::string& path);
    void takeOwner(const std::string& owner);
    void askForObjects();
    void process();
    void wait();
    void waitUntil(std::chrono::microseconds due);
    void lose();
    std::function<void()> guarded(void (Connection::*member)());

    AsioMainQueue& queue;
    BusHandle bus;
    std::array<BusSlot, kMatches.size()> matches;
    std::list<Pending> pending;
    std::unique_ptr<DescriptorWatch> descriptor;
    bool isReading = false;
    bool isWriting = false;
    std::chrono::microseconds timer = std::chrono::microseconds::max();
    ModemWatch* watch = nullptr;
    std::function<void()> lost;
    std::string owner; ///< of ModemManager's name, as far as signals tell
    std::shared_ptr<Connection*> alive = std::make_shared<Connection*>(this);
};

bool ModemBus::Connection::connect() {
    sd_bus* opened = nullptr;
    if (sd_bus_open_system(&opened) < 0) {
        return false;
    }
    bus.reset(opened);
    for (std::size_t index = 0; index < kMatches.size(); ++index) {
        sd_bus_slot* slot = nullptr;
        if (sd_bus_add_match_async(opened, &slot, kMatches[index], onSignal, nullptr, this) < 0) {
            return false;
        }
        matches[index].reset(slot);
    }
    return true;
}

BusMessage ModemBus::Connection::messageOf(const BusCall& call) const {
    sd_bus_message* made = nullptr;
    if (sd_bus_message_new_method_call(bus.get(), &made, modem_names::kService, call.path.c_str(),
                                       call.interface.c_str(), call.method.c_str()) < 0) {
        return nullptr; // a path from the bus that is none
    }
    BusMessage message(made);
    int result = 0;
    if (call.text) {
        result = sd_bus_message_append_basic(made, SD_BUS_TYPE_STRING, call.text->c_str());
    } else if (call.number) {
        const std::uint32_t number = *call.number;
        result = sd_bus_message_append_basic(made, SD_BUS_TYPE_UINT32, &number);
    }
    return result < 0 ? nullptr : std::move(message);
}

void ModemBus::Connection::send(const BusCall& call, std::function<void(const BusReply&)> answer) {
    const BusMessage message = bus != nullptr ? messageOf(call) : nullptr;
    Pending& made = pending.emplace_back(Pending{*this, std::move(answer)});
    made.place = std::prev(pending.end());
    sd_bus_slot* slot = nullptr;
    const int result = message == nullptr
                           ? -ENOTCONN
                           : sd_bus_call_async(bus.get(), &slot, message.get(), onAnswer, &made,
                                               microseconds(call.patience));
    if (result >= 0) {
        made.slot.reset(slot);
        wait();
        return;
    }
    auto failed = std::move(made.answer);
    pending.erase(made.place);
    queue.async([failed = std::move(failed), result, here = std::weak_ptr(alive)] {
        if (!here.expired()) {
            failed(errorOf(result));
        }
    });
}

int ModemBus::Connection::onAnswer(sd_bus_message* message, void* pending,
                                   sd_bus_error* /*error*/) {
    auto& call = *static_cast<Pending*>(pending);
    Connection& connection = call.connection;
    const auto answer = std::move(call.answer);
    connection.pending.erase(call.place);
    answer(replyOf(message));
    return 1;
}

int ModemBus::Connection::onSignal(sd_bus_message* message, void* connection,
                                   sd_bus_error* /*error*/) {
    const char* member = sd_bus_message_get_member(message);
    const char* path = sd_bus_message_get_path(message);
    if (member != nullptr && path != nullptr) {
        static_cast<Connection*>(connection)->take(member, argumentsOf(message), path);
    }
    return 0;
}

void ModemBus::Connection::take(std::string_view member, const Array& arguments,
                                const std::string& path) {
    constexpr std::size_t kLeast = 2;
    const auto first = arguments.size() >= kLeast ? arguments[0].string() : std::nullopt;
    if (!first || watch == nullptr) {
        return;
    }
    if (member == "NameOwnerChanged") {
        takeOwner(arguments.size() > kLeast ? arguments[2].string().value_or("") : "");
    } else if (member == "PropertiesChanged" && arguments[1].dictionary() != nullptr) {
        watch->propertiesChanged(path, *first, *arguments[1].dictionary());
    } else if (member == "InterfacesAdded" && arguments[1].dictionary() != nullptr) {
        watch->interfacesAdded(*first, *arguments[1].dictionary());
    } else if (member == "InterfacesRemoved" && arguments[1].array() != nullptr) {
        std::vector<std::string> interfaces;
        for (const PropertyList& each : *arguments[1].array()) {
            interfaces.push_back(each.string().value_or(""));
        }
        watch->interfacesRemoved(*first, interfaces);
    }
}

void ModemBus::Connection::takeOwner(const std::string& newOwner) {
    owner = newOwner;
    watch->managerLeft(ModemView::Presence::NoManager);
    if (!owner.empty()) {
        askForObjects();
    }
}

void ModemBus::Connection::askForObjects() {
    send(managedObjects(), [this, asked = owner](const BusReply& reply) {
        if (asked != owner) {
            return; // that ModemManager has gone
        }
        if (reply) {
            watch->managerCame(*reply);
        } else if (!owner.empty() || reply.error().isUnanswered()) {
            queue.after(kRetry, guarded(&Connection::askForObjects));
        } else {
            watch->managerLeft(ModemView::Presence::NoManager);
        }
    });
}

void ModemBus::Connection::process() {
    for (int count = 0; count < kMessagesPerBlock && bus != nullptr; ++count) {
        const int result = sd_bus_process(bus.get(), nullptr);
        if (result < 0) {
            return lose();
        }
        if (result == 0) {
            return wait();
        }
    }
    queue.async(guarded(&Connection::process));
}

/// Waits for what the bus waits for.
void ModemBus::Connection::wait() {
    if (bus == nullptr || descriptor == nullptr) {
        return; // before it is followed
    }
    const int events = sd_bus_get_events(bus.get());
    std::uint64_t due = std::numeric_limits<std::uint64_t>::max();
    if (events < 0 || sd_bus_get_timeout(bus.get(), &due) < 0) {
        queue.async(guarded(&Connection::lose));
        return;
    }
    const auto once = [this](bool Connection::*isWaiting) {
        this->*isWaiting = true;
        return [here = std::weak_ptr(alive), isWaiting] {
            if (const auto connection = here.lock()) {
                (*connection)->*isWaiting = false;
                (*connection)->process();
            }
        };
    };
    if ((events & POLLIN) != 0 && !isReading) {
        descriptor->onceReadable(once(&Connection::isReading));
    }
    if ((events & POLLOUT) != 0 && !isWriting) {
        descriptor->onceWritable(once(&Connection::isWriting));
    }
    if (due < static_cast<std::uint64_t>(std::chrono::microseconds::max().count())) {
        waitUntil(std::chrono::microseconds(due));
    }
}

/// One timer at a time, unless an earlier one is needed.
void ModemBus::Connection::waitUntil(std::chrono::microseconds due) {
    if (due >= timer) {
        return;
    }
    timer = due;
    const auto delay = std::max(due - monotonicNow(), std::chrono::microseconds(0));
    queue.after(delay, [here = std::weak_ptr(alive), due] {
        const auto connection = here.lock();
        if (connection != nullptr && (*connection)->timer == due) {
            (*connection)->timer = std::chrono::microseconds::max();
            (*connection)->process();
        }
    });
}

void ModemBus::Connection::lose() {
    if (bus == nullptr) {
        return;
    }
    descriptor.reset();
    for (BusSlot& match : matches) {
        match.reset();
    }
    pending.clear();
    bus.reset();
    if (lost) {
        queue.async([lost = lost] { lost(); }); // which destroys this
    }
}

std::function<void()> ModemBus::Connection::guarded(void (Connection::*member)()) {
    return [here = std::weak_ptr(alive), member] {
        if (const auto connection = here.lock()) {
            ((*connection)->*member)();
        }
    };
}

ModemBus::ModemBus(std::unique_ptr<Connection> connection) : _connection(std::move(connection)) {}

ModemBus::~ModemBus() = default;

Result<std::unique_ptr<ModemBus>, HostError> ModemBus::open(AsioMainQueue& queue) {
    auto connection = std::make_unique<Connection>(queue);
    if (!connection->connect()) {
        return HostError{"There is no system bus, through which ModemManager is asked."};
    }
    return std::unique_ptr<ModemBus>(new ModemBus(std::move(connection)));
}

BusCall ModemBus::managedObjects() {
    return {modem_names::kRoot, "org.freedesktop.DBus.ObjectManager", "GetManagedObjects"};
}

BusReply ModemBus::callNow(const BusCall& call) {
    const BusMessage message = _connection->bus != nullptr ? _connection->messageOf(call) : nullptr;
    if (message == nullptr) {
        return errorOf(-ENOTCONN);
    }
    sd_bus_message* reply = nullptr;
    sd_bus_error error{nullptr, nullptr, 0};
    const int result = sd_bus_call(_connection->bus.get(), message.get(),
                                   microseconds(call.patience), &error, &reply);
    const BusMessage received(reply);
    if (result < 0) {
        BusError told = error.name != nullptr
                            ? BusError{error.name, error.message != nullptr ? error.message : ""}
                            : errorOf(result);
        sd_bus_error_free(&error);
        return told;
    }
    return replyOf(reply);
}

void ModemBus::call(const BusCall& call, std::function<void(const BusReply&)> answer) {
    _connection->send(call, std::move(answer));
}

void ModemBus::askForObjects() {
    _connection->askForObjects();
}

void ModemBus::follow(ModemWatch& watch, std::function<void()> lost) {
    _connection->watch = &watch;
    _connection->lost = std::move(lost);
    _connection->descriptor = std::make_unique<DescriptorWatch>(
        _connection->queue, sd_bus_get_fd(_connection->bus.get()));
    _connection->process();
}

} // namespace pallax
