#include "fleet/HttpExchange.h"
#include "store/MeasurementStore.h"
#include "text/Format.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <curl/curl.h>
#include <exception>

namespace pallax {

namespace {

using SteadyClock = std::chrono::steady_clock;

/// One request and its answer.
struct Running {
    const HttpExchange::Give& give;
    const HttpExchange::Take& take;
    const Patience& patience;
    CURL* handle;
    std::string_view piece = {}; ///< what is left of the latest one
    bool isSent = false;
    curl_off_t bytes = 0; ///< in both directions
    SteadyClock::time_point start = SteadyClock::now();
    SteadyClock::time_point active = start;
    bool isSilent = false;
    bool isLate = false;
    std::exception_ptr thrown = {};
};

std::size_t read(char* buffer, std::size_t size, std::size_t count, void* user) {
    auto& running = *static_cast<Running*>(user);
    try {
        if (running.piece.empty() && !running.isSent) {
            running.piece = running.give();
            running.isSent = running.piece.empty();
        }
    } catch (...) {
        running.thrown = std::current_exception();
        return CURL_READFUNC_ABORT;
    }
    const std::size_t taken = std::min(running.piece.size(), size * count);
    std::copy_n(running.piece.data(), taken, buffer);
    running.piece.remove_prefix(taken);
    return taken;
}

std::size_t write(char* bytes, std::size_t size, std::size_t count, void* user) {
    auto& running = *static_cast<Running*>(user);
    try {
        long status = 0;
        curl_easy_getinfo(running.handle, CURLINFO_RESPONSE_CODE, &status);
        running.take(static_cast<int>(status), {bytes, size * count});
    } catch (...) {
        running.thrown = std::current_exception();
        return 0;
    }
    return size * count;
}

/// Called often, at least about once a second.
int look(void* user, curl_off_t /*expected*/, curl_off_t received, curl_off_t /*toSend*/,
         curl_off_t sent) {
    auto& running = *static_cast<Running*>(user);
    const auto now = SteadyClock::now();
    if (received + sent != running.bytes) {
        running.bytes = received + sent;
        running.active = now;
    }
    running.isSilent = now - running.active >= running.patience.silence;
    running.isLate = running.patience.whole && now - running.start >= *running.patience.whole;
    return running.isSilent || running.isLate ? 1 : 0;
}

template <class Value>
void set(CURL* handle, CURLoption option, Value value) {
    curl_easy_setopt(handle, option, value); // NOLINT(*-vararg)
}

std::string secondsText(std::chrono::milliseconds time) {
    const bool isWhole =
        time.count() % std::chrono::milliseconds(std::chrono::seconds(1)).count() == 0;
    return formatText(isWhole ? "%.0f s" : "%.1f s", {std::chrono::duration<double>(time).count()});
}

} // namespace

struct HttpExchange::Impl {
    struct Free {
        void operator()(CURL* easy) const { curl_easy_cleanup(easy); }
        void operator()(curl_slist* list) const { curl_slist_free_all(list); }
    };

    StoreAddress address;
    Patience patience;
    std::unique_ptr<CURL, Free> handle{curl_easy_init()};
    std::unique_ptr<curl_slist, Free> headers;

    void prepare();
    [[noreturn]] void fail(CURLcode code, const Running& running) const;
};

void HttpExchange::Impl::prepare() {
    if (handle == nullptr) {
        throw StoreFailure(address.text() + " cannot be reached: there is no memory.");
    }
    CURL* curl = handle.get();
    set(curl, CURLOPT_NOSIGNAL, 1L);
    set(curl, CURLOPT_PROTOCOLS_STR, "http,https");
    set(curl, CURLOPT_PROXY, "");
    set(curl, CURLOPT_POST, 1L);
    set(curl, CURLOPT_CONNECTTIMEOUT_MS, static_cast<long>(patience.connect.count()));
    const char* user = std::getenv("PALLAX_CLICKHOUSE_USER");         // NOLINT(*-mt-unsafe)
    const char* password = std::getenv("PALLAX_CLICKHOUSE_PASSWORD"); // NOLINT(*-mt-unsafe)
    if (user != nullptr || password != nullptr) {
        set(curl, CURLOPT_USERNAME, user != nullptr ? user : "default");
        set(curl, CURLOPT_PASSWORD, password != nullptr ? password : "");
    } else {
        set(curl, CURLOPT_NETRC, static_cast<long>(CURL_NETRC_OPTIONAL));
    }
    // The length is not known before. A server that refuses says so without being asked first.
    for (const char* header : {"Transfer-Encoding: chunked", "Expect:", "Content-Type:"}) {
        curl_slist* longer = curl_slist_append(headers.get(), header);
        (void)headers.release();
        headers.reset(longer);
    }
    set(curl, CURLOPT_HTTPHEADER, headers.get());
    set(curl, CURLOPT_READFUNCTION, read);
    set(curl, CURLOPT_WRITEFUNCTION, write);
    set(curl, CURLOPT_XFERINFOFUNCTION, look);
    set(curl, CURLOPT_NOPROGRESS, 0L);
}

void HttpExchange::Impl::fail(CURLcode code, const Running& running) const {
    const std::string where = address.text();
    if (running.isLate) {
        throw StoreFailure("The query was stopped after its time (--timeout).");
    }
    if (running.isSilent) {
        throw StoreFailure(
            formatText("%@ has not answered for %@.", {where, secondsText(patience.silence)}));
    }
    switch (code) {
    case CURLE_COULDNT_RESOLVE_HOST:
        throw StoreFailure(formatText("%@ cannot be reached: no address is known for the host %@.",
                                      {where, address.host}));
    case CURLE_COULDNT_CONNECT:
    case CURLE_OPERATION_TIMEDOUT:
        throw StoreFailure(formatText("%@ cannot be reached: no server answers there.", {where}));
    case CURLE_PARTIAL_FILE:
    case CURLE_GOT_NOTHING:
    case CURLE_RECV_ERROR:
    case CURLE_SEND_ERROR:
        throw StoreFailure(formatText("%@ has broken the connection off.", {where}));
    default:
        throw StoreFailure(formatText("%@ cannot be used: %@.", {where, curl_easy_strerror(code)}));
    }
}

HttpExchange::HttpExchange(const StoreAddress& address, Patience patience)
    : _impl(new Impl{address, patience, std::unique_ptr<CURL, Impl::Free>(curl_easy_init()), {}}) {
    _impl->prepare();
}

HttpExchange::~HttpExchange() = default;

int HttpExchange::post(const std::string& parameters, const Give& give, const Take& take) {
    CURL* curl = _impl->handle.get();
    const std::string url = _impl->address.httpAddress() + "/" + parameters;
    Running running{give, take, _impl->patience, curl};
    set(curl, CURLOPT_URL, url.c_str());
    set(curl, CURLOPT_READDATA, static_cast<void*>(&running));
    set(curl, CURLOPT_WRITEDATA, static_cast<void*>(&running));
    set(curl, CURLOPT_XFERINFODATA, static_cast<void*>(&running));
    const CURLcode code = curl_easy_perform(curl);
    if (running.thrown) {
        std::rethrow_exception(running.thrown);
    }
    if (code != CURLE_OK) {
        _impl->fail(code, running);
    }
    long status = 0;
    curl_easy_getinfo(curl, CURLINFO_RESPONSE_CODE, &status);
    return static_cast<int>(status);
}

} // namespace pallax
