#include "web/HttpServer.h"

#include "host/AsioMainQueue.h"
#include "text/Format.h"
#include "web/EventStream.h"
#include "web/InternetAddress.h"

#include <algorithm>
#include <array>
#include <fcntl.h>
#include <microhttpd.h>
#include <sys/socket.h>
#include <unordered_map>
#include <utility>

namespace pallax {

namespace {

using Steady = std::chrono::steady_clock;

/// How often the deadlines of clients are looked at.
constexpr std::chrono::milliseconds kLookInterval{250};
constexpr std::size_t kStreamBlock = 16384;

struct FreeResponse {
    void operator()(MHD_Response* response) const { MHD_destroy_response(response); }
};
using ResponseOwner = std::unique_ptr<MHD_Response, FreeResponse>;

enum MHD_Result addField(void* fields, enum MHD_ValueKind /*kind*/, const char* name,
                         std::size_t nameSize, const char* value, std::size_t valueSize) {
    static_cast<WebRequest::Fields*>(fields)->emplace_back(
        std::string(name, nameSize), value != nullptr ? std::string(value, valueSize) : "");
    return MHD_YES;
}

WebRequest requestOf(MHD_Connection* connection, const char* path, const char* method) {
    WebRequest request{.method = method, .path = path};
    (void)MHD_get_connection_values_n(connection, MHD_HEADER_KIND, addField, &request.headers);
    (void)MHD_get_connection_values_n(connection, MHD_GET_ARGUMENT_KIND, addField, &request.query);
    const auto* info = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CLIENT_ADDRESS);
    request.isFromThisMachine =
        info != nullptr && InternetAddress::of(info->client_addr).isLoopback();
    return request;
}

} // namespace

struct HttpServer::Impl {
    struct Client {
        int socket;
        Steady::time_point deadline;
        std::unique_ptr<EventStream> stream = {}; ///< null unless that is the answer
        bool hasAsked = false;                    ///< or is cut off: it holds no place for nothing
    };

    explicit Impl(Setup given) : setup(std::move(given)) {}
    ~Impl();
    bool start();

    void runOnce();
    void wait();
    void look();
    void cut(const Client& client) const { (void)::shutdown(client.socket, SHUT_RDWR); }
    void makeRoom();
    std::size_t streams() const;
    void publish(const std::shared_ptr<const std::string>& text);
    ResponseOwner streamOf(MHD_Connection* connection, const WebResponse& response);
    bool answer(MHD_Connection* connection, const char* path, const char* method);

    // What the library calls.
    static void noteConnection(void* self, MHD_Connection* connection, void** context,
                               enum MHD_ConnectionNotificationCode code);
    static enum MHD_Result handle(void* self, MHD_Connection* connection, const char* path,
                                  const char* method, const char* version, const char* upload,
                                  std::size_t* uploadSize, void** context);

    Setup setup;
    MHD_Daemon* daemon = nullptr;
    std::unordered_map<MHD_Connection*, Client> clients;
    std::optional<DescriptorWatch> watch;
    std::unique_ptr<RepeatingTimer> looks;
    std::unique_ptr<RepeatingTimer> heartbeats;
    std::exception_ptr failure; ///< of an answer; C code cannot pass it on
    std::shared_ptr<Impl*> alive = std::make_shared<Impl*>(this);
};

bool HttpServer::Impl::start() {
    const auto& identity = setup.identity;
    const auto option = [](enum MHD_OPTION name, std::intptr_t value, const void* pointer) {
        return MHD_OptionItem{name, value, const_cast<void*>(pointer)};
    };
    const int listening = ::fcntl(setup.listener.socket.number(), F_DUPFD_CLOEXEC, 0);
    std::vector<MHD_OptionItem> options{
        option(MHD_OPTION_LISTEN_SOCKET, listening, nullptr),
        option(MHD_OPTION_CONNECTION_LIMIT, setup.limits.connections, nullptr),
        option(MHD_OPTION_CONNECTION_MEMORY_LIMIT,
               static_cast<std::intptr_t>(setup.limits.requestBytes), nullptr),
        option(MHD_OPTION_SIGPIPE_HANDLED_BY_APP, 1, nullptr)};
    if (identity) {
        options.push_back(option(MHD_OPTION_HTTPS_MEM_CERT, 0, identity->certificate.c_str()));
        options.push_back(option(MHD_OPTION_HTTPS_MEM_KEY, 0, identity->key.c_str()));
    }
    options.push_back(option(MHD_OPTION_END, 0, nullptr));
    unsigned flags = MHD_USE_EPOLL | MHD_ALLOW_SUSPEND_RESUME;
    if (identity) {
        flags |= MHD_USE_TLS;
    }
    daemon =
        MHD_start_daemon(flags, 0, nullptr, nullptr, &handle, this, MHD_OPTION_NOTIFY_CONNECTION,
                         &noteConnection, this, MHD_OPTION_ARRAY, options.data(), MHD_OPTION_END);
    if (daemon == nullptr) {
        (void)::close(listening);
        return false;
    }
    watch.emplace(setup.queue, MHD_get_daemon_info(daemon, MHD_DAEMON_INFO_EPOLL_FD)->epoll_fd);
    looks = setup.queue.scheduleRepeating(kLookInterval, [this] { look(); });
    heartbeats = setup.queue.scheduleRepeating(setup.limits.heartbeat, [this] {
        publish(std::make_shared<const std::string>(EventStream::kHeartbeat));
    });
    wait();
    return true;
}

/// The library must not be ended while a connection is suspended.
HttpServer::Impl::~Impl() {
    if (daemon == nullptr) {
        return;
    }
    watch.reset();
    for (auto& [connection, client] : clients) {
        if (client.stream != nullptr) {
            client.stream->end();
        }
    }
    (void)MHD_run(daemon);
    MHD_stop_daemon(daemon);
}

void HttpServer::Impl::wait() {
    watch->onceReadable([this] {
        wait();
        runOnce();
    });
}

void HttpServer::Impl::runOnce() {
    const bool wasFull = clients.size() >= setup.limits.connections;
    (void)MHD_run(daemon);
    if (failure != nullptr) {
        std::rethrow_exception(std::exchange(failure, nullptr));
    }
    // Full, it does not watch its listening socket until the next run.
    const bool hasRoomAgain = wasFull && clients.size() < setup.limits.connections;
    MHD_UNSIGNED_LONG_LONG timeout = 0;
    if (hasRoomAgain || (MHD_get_timeout(daemon, &timeout) == MHD_YES && timeout == 0)) {
        setup.queue.async([weak = std::weak_ptr(alive)] { // it has more to do
            if (const auto self = weak.lock()) {
                (*self)->runOnce();
            }
        });
    }
}

void HttpServer::Impl::look() {
    const Steady::time_point now = Steady::now();
    for (auto& [connection, client] : clients) {
        if (client.stream == nullptr && now > client.deadline) {
            cut(client);
        }
    }
    runOnce();
}

/// Idle connections cannot lock others out.
void HttpServer::Impl::makeRoom() {
    if (clients.size() + setup.limits.spare <= setup.limits.connections) {
        return;
    }
    Client* oldest = nullptr;
    for (auto& [connection, client] : clients) {
        const bool isOlder = oldest == nullptr || client.deadline < oldest->deadline;
        oldest = !client.hasAsked && isOlder ? &client : oldest;
    }
    if (oldest != nullptr) {
        oldest->hasAsked = true;
        cut(*oldest);
    }
}

std::size_t HttpServer::Impl::streams() const {
    return static_cast<std::size_t>(
        std::count_if(clients.begin(), clients.end(),
                      [](const auto& each) { return each.second.stream != nullptr; }));
}

void HttpServer::Impl::publish(const std::shared_ptr<const std::string>& text) {
    bool isAny = false;
    for (auto& [connection, client] : clients) {
        if (client.stream != nullptr) {
            isAny = true;
            if (!client.stream->add(text)) {
                cut(client);
            }
        }
    }
    if (isAny) {
        runOnce();
    }
}

void HttpServer::Impl::noteConnection(void* self, MHD_Connection* connection, void** /*context*/,
                                      enum MHD_ConnectionNotificationCode code) {
    auto& server = *static_cast<Impl*>(self);
    if (code == MHD_CONNECTION_NOTIFY_CLOSED) {
        server.clients.erase(connection);
        return;
    }
    const auto* info = MHD_get_connection_info(connection, MHD_CONNECTION_INFO_CONNECTION_FD);
    server.makeRoom();
    server.clients[connection] = {info->connect_fd, Steady::now() + server.setup.limits.request};
}

enum MHD_Result HttpServer::Impl::handle(void* self, MHD_Connection* connection, const char* path,
                                         const char* method, const char* /*version*/,
                                         const char* /*upload*/, std::size_t* /*uploadSize*/,
                                         void** /*context*/) {
    auto& server = *static_cast<Impl*>(self);
    try {
        return server.answer(connection, path, method) ? MHD_YES : MHD_NO;
    } catch (...) {
        server.failure = std::current_exception();
        return MHD_NO;
    }
}

ResponseOwner HttpServer::Impl::streamOf(MHD_Connection* connection, const WebResponse& response) {
    auto stream = std::make_unique<EventStream>(*connection, setup.limits.waitingBytes);
    (void)stream->add(response.content);
    EventStream* const kept = stream.get();
    clients.at(connection).stream = std::move(stream);
    return ResponseOwner(MHD_create_response_from_callback(
        MHD_SIZE_UNKNOWN, kStreamBlock,
        [](void* from, std::uint64_t /*position*/, char* to, std::size_t most) {
            return static_cast<EventStream*>(from)->read({to, most});
        },
        kept, nullptr));
}

/// The content is shared by all responses that have it.
ResponseOwner responseOf(const WebResponse& response) {
    auto kept = std::make_unique<std::shared_ptr<const std::string>>(response.content);
    const std::string& content = **kept;
    return ResponseOwner(MHD_create_response_from_buffer_with_free_callback_cls(
        content.size(), const_cast<char*>(content.data()),
        [](void* owner) { delete static_cast<std::shared_ptr<const std::string>*>(owner); },
        kept.release()));
}

/// A request is answered as soon as its headers are there: it has no content.
bool HttpServer::Impl::answer(MHD_Connection* connection, const char* path, const char* method) {
    WebResponse response = setup.answer(requestOf(connection, path, method));
    if (response.isStream && streams() >= setup.limits.streams) {
        response = textResponse(503, "Too many pages follow already.");
    }
    Client& client = clients.at(connection);
    client.hasAsked = true;
    client.deadline = Steady::now() + setup.limits.response;
    const ResponseOwner made =
        response.isStream ? streamOf(connection, response) : responseOf(response);
    const auto add = [&made](const std::string& name, const std::string& value) {
        (void)MHD_add_response_header(made.get(), name.c_str(), value.c_str());
    };
    add("Content-Type", response.type);
    add("Connection", "close");
    for (const auto& [name, value] : headersOf(response)) {
        add(name, value);
    }
    return MHD_queue_response(connection, response.status, made.get()) == MHD_YES;
}

HttpServer::HttpServer(std::unique_ptr<Impl> impl) : _impl(std::move(impl)) {}

HttpServer::~HttpServer() = default;

Result<std::unique_ptr<HttpServer>, HostError> HttpServer::start(Setup setup) {
    auto impl = std::make_unique<Impl>(std::move(setup));
    if (!impl->start()) {
        return HostError{impl->setup.identity ? "The certificate and its key cannot be used."
                                              : "The web server cannot be started."};
    }
    return std::unique_ptr<HttpServer>(new HttpServer(std::move(impl)));
}

void HttpServer::publish(std::shared_ptr<const std::string> text) {
    _impl->publish(text);
}

std::size_t HttpServer::streams() const {
    return _impl->streams();
}

} // namespace pallax
